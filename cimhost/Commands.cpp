#include "cimhost/Commands.h"

#include "cimhost/DefinitionFiles.h"
#include "cimhost/RequestArguments.h"
#include "cimhost/output/DisplayText.h"
#include "cimhost/output/MofText.h"

#include <pwd.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <string>

namespace cimhost {

namespace {

using Command = CommandLine::Command;

// Knows whether anything came: what a failed operation delivered before is still closed properly.
// Leaves out the host's own name, so that a printed path can be given to the next command.
class CommandWriter final : public ResultWriter {
 public:
  CommandWriter(std::unique_ptr<ResultWriter> writer, Pegasus::String hostName)
      : writer_(std::move(writer)), hostName_(std::move(hostName)) {}

  bool deliverInstance(const Pegasus::CIMInstance& instance) override {
    any_ = true;
    Pegasus::CIMObjectPath path = instance.getPath();
    if (!leaveOutHost(path)) return writer_->deliverInstance(instance);
    Pegasus::CIMInstance printed = instance.clone();
    printed.setPath(path);
    return writer_->deliverInstance(printed);
  }
  bool deliverPath(const Pegasus::CIMObjectPath& path) override {
    any_ = true;
    Pegasus::CIMObjectPath printed = path;
    leaveOutHost(printed);
    return writer_->deliverPath(printed);
  }
  bool deliverClass(const Pegasus::CIMClass& declaration) override {
    any_ = true;
    return writer_->deliverClass(declaration);
  }
  bool deliverClassName(const Pegasus::CIMName& name) override {
    any_ = true;
    return writer_->deliverClassName(name);
  }
  bool deliverMethodResult(const Pegasus::CIMValue& returnValue,
                           const Pegasus::Array<Pegasus::CIMParamValue>& parameters) override {
    any_ = true;
    return writer_->deliverMethodResult(returnValue, parameters);
  }
  void finish() override { writer_->finish(); }

  bool any() const { return any_; }

 private:
  bool leaveOutHost(Pegasus::CIMObjectPath& path) const {
    if (path.getHost().size() == 0 || path.getHost() != hostName_) return false;
    path.setHost(Pegasus::String());
    return true;
  }

  std::unique_ptr<ResultWriter> writer_;
  Pegasus::String hostName_;
  bool any_ = false;
};

InstanceSelection selectionOf(const CommandLine& line) {
  return {line.deep, line.localOnly, line.includeQualifiers, line.includeClassOrigin,
          line.properties};
}

// Whose rights the program has, as a server would have found out from a client of its own machine.
std::string userName() {
  const passwd* entry = getpwuid(geteuid());
  return entry != nullptr ? entry->pw_name : std::to_string(geteuid());
}

// The names of the classes, or with MOF their declarations, from which they can be compiled again.
OperationStatus listClasses(const CommandLine& line, const Operations& operations,
                            ResultWriter& writer) {
  const Pegasus::CIMNamespaceName& nameSpace = line.target.getNameSpace();
  const Pegasus::CIMName& className = line.target.getClassName();
  if (line.format != OutputFormat::mof) {
    return operations.enumerateClassNames({nameSpace, className, line.deep}, writer);
  }
  return operations.enumerateClasses({nameSpace, className, line.deep, true, true, false}, writer);
}

OperationStatus findClass(const CommandLine& line, const Host& host,
                          Pegasus::CIMClass& declaration) {
  return runOperation([&] {
    declaration = host.repository().getClass(line.target.getNameSpace(), line.target.getClassName(),
                                             false, true, true, Pegasus::CIMPropertyList());
  });
}

// Throws ValueArgumentError before anything is asked of the provider.
OperationStatus modify(const CommandLine& line, const Host& host,
                       const Pegasus::OperationContext& context) {
  Pegasus::CIMClass declaration;
  OperationStatus status = findClass(line, host, declaration);
  // Of an instance's class, unlike the target of a method, this is what a client is told.
  if (status.code == Pegasus::CIM_ERR_NOT_FOUND) status.code = Pegasus::CIM_ERR_INVALID_CLASS;
  if (!status.ok()) return status;
  return host.operations().modifyInstance(context,
                                          makeModifyRequest(declaration, line.target, line.values));
}

OperationStatus invoke(const CommandLine& line, const Host& host,
                       const Pegasus::OperationContext& context, ResultWriter& writer) {
  Pegasus::CIMClass declaration;
  const OperationStatus status = findClass(line, host, declaration);
  if (!status.ok()) return status;
  return host.operations().invokeMethod(
      context, makeInvokeRequest(declaration, line.target, line.method, line.values), writer);
}

OperationStatus runOperationCommand(const CommandLine& line, const Host& host,
                                    ResultWriter& writer) {
  const Operations& operations = host.operations();
  const Pegasus::OperationContext context = makeContext(userName());
  const Pegasus::CIMNamespaceName& nameSpace = line.target.getNameSpace();
  const Pegasus::CIMName& className = line.target.getClassName();
  switch (line.command) {
    case Command::enumerate:
      return operations.enumerateInstances(context, {nameSpace, className, selectionOf(line)},
                                           writer);
    case Command::names:
      return operations.enumerateInstanceNames(context, {nameSpace, className}, writer);
    case Command::get:
      return operations.getInstance(context, {nameSpace, line.target, selectionOf(line)}, writer);
    case Command::modify:
      return modify(line, host, context);
    case Command::invoke:
      return invoke(line, host, context, writer);
    case Command::associators:
      return operations.associators(
          context, {nameSpace, line.target, line.filter, selectionOf(line)}, writer);
    case Command::associatorNames:
      return operations.associatorNames(context, {nameSpace, line.target, line.filter}, writer);
    case Command::references:
      return operations.references(
          context, {nameSpace, line.target, line.filter, selectionOf(line)}, writer);
    case Command::referenceNames:
      return operations.referenceNames(context, {nameSpace, line.target, line.filter}, writer);
    case Command::declaration:
      return operations.getClass({nameSpace, className, line.localOnly, line.includeQualifiers,
                                  line.includeClassOrigin, line.properties},
                                 writer);
    case Command::classes:
      return listClasses(line, operations, writer);
    case Command::qualifiers:
    case Command::check:
    case Command::registration:
    case Command::dump:
    case Command::serve:
      break;
  }
  return {};
}

ResultForm formOf(Command command) {
  const bool single =
      command == Command::get || command == Command::invoke || command == Command::declaration;
  return single ? ResultForm::single : ResultForm::list;
}

void print(const std::vector<Diagnostic>& problems, std::ostream& out) {
  for (const Diagnostic& problem : problems) out << problem.toString() << '\n';
}

int outputCode(const std::ostream& out, std::ostream& error) {
  if (out) return ExitCode::kOk;
  error << "cimhost: the results could not be written\n";
  return ExitCode::kOutput;
}

int operationCode(const OperationStatus& status, std::ostream& error) {
  error << "cimhost: " << displayText(status.toString()) << '\n';
  return ExitCode::kOperation + static_cast<int>(status.code);
}

bool isError(const Diagnostic& problem) {
  return problem.severity == Diagnostic::Severity::error;
}

std::string counted(std::ptrdiff_t count, const std::string& noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

}  // namespace

bool needsProvider(Command command) {
  switch (command) {
    case Command::declaration:
    case Command::classes:
    case Command::qualifiers:
    case Command::check:
    case Command::registration:
    case Command::dump:
      return false;
    default:
      return true;
  }
}

int runCommand(const CommandLine& line, const Host& host, std::ostream& out, std::ostream& error) {
  if (line.command == Command::check) return runCheck(host, out);
  if (line.command == Command::registration) return runRegistration(line, host, out, error);
  print(host.diagnostics(), error);
  if (line.command == Command::qualifiers) return runQualifiers(line, host, out, error);
  CommandWriter writer(makeResultWriter(line.format, out, formOf(line.command), line.method),
                       host.operations().hostName());
  OperationStatus status;
  try {
    status = runOperationCommand(line, host, writer);
  } catch (const ValueArgumentError& problem) {
    error << "cimhost: " << problem.what() << '\n';
    return ExitCode::kUsage;
  }
  const bool hasResult = line.command != Command::modify;
  if ((status.ok() && hasResult) || writer.any()) writer.finish();
  return status.ok() ? outputCode(out, error) : operationCode(status, error);
}

int runQualifiers(const CommandLine& line, const Host& host, std::ostream& out,
                  std::ostream& error) {
  const Pegasus::CIMNamespaceName& nameSpace = line.target.getNameSpace();
  const OperationStatus status = runOperation([&] {
    for (const QualifierDeclaration& each : host.repository().qualifiers(nameSpace)) {
      out << mofQualifier(each);
    }
  });
  if (!status.ok()) return operationCode(status, error);
  out.flush();
  return outputCode(out, error);
}

int runRegistration(const CommandLine& line, const Host& host, std::ostream& out,
                    std::ostream& error) {
  const std::vector<Diagnostic>& problems = host.diagnostics();
  print(problems, error);
  if (std::any_of(problems.begin(), problems.end(), isError)) return ExitCode::kProblems;
  const Registration registration(host.served(), host.repository());
  print(registration.warnings(), error);
  if (registration.capabilities().empty()) {
    error << "cimhost: nothing to register: no definition serves a class\n";
    return ExitCode::kProblems;
  }
  registration.write(out, line.registration);
  out.flush();
  return outputCode(out, error);
}

int runDump(const CommandLine& line, std::ostream& error) {
  const Home home(line.home);
  std::vector<Diagnostic> problems;
  if (line.files.empty()) {
    home.enterRun();
    problems = dumpDefinitions(findDefinitionFiles("."), "run/");
  } else {
    problems = dumpDefinitions(line.files, "");
  }
  const bool written = std::fflush(stdout) == 0 && std::ferror(stdout) == 0;
  print(problems, error);
  if (!written) {
    error << "cimhost: the dumps could not be written\n";
    return ExitCode::kOutput;
  }
  return problems.empty() ? ExitCode::kOk : ExitCode::kProblems;
}

int runCheck(const Host& host, std::ostream& out) {
  const std::vector<Diagnostic>& problems = host.diagnostics();
  print(problems, out);
  const auto errors = std::count_if(problems.begin(), problems.end(), isError);
  const auto warnings = static_cast<std::ptrdiff_t>(problems.size()) - errors;
  const auto served = static_cast<std::ptrdiff_t>(host.served().all().size());
  out << counted(served, "definition") << ", " << counted(errors, "error") << ", "
      << counted(warnings, "warning") << std::endl;
  if (!out) return ExitCode::kOutput;
  return errors > 0 ? ExitCode::kProblems : ExitCode::kOk;
}

}  // namespace cimhost
