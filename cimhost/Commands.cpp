#include "cimhost/Commands.h"

#include "cimhost/output/DisplayText.h"

#include <unistd.h>

#include <algorithm>
#include <string>

namespace cimhost {

namespace {

using Command = CommandLine::Command;

// Knows whether anything came: what a failed operation delivered before is still closed properly.
class CountingWriter final : public ResultWriter {
 public:
  explicit CountingWriter(std::unique_ptr<ResultWriter> writer) : writer_(std::move(writer)) {}

  bool deliverInstance(const Pegasus::CIMInstance& instance) override {
    any_ = true;
    return writer_->deliverInstance(instance);
  }
  bool deliverPath(const Pegasus::CIMObjectPath& path) override {
    any_ = true;
    return writer_->deliverPath(path);
  }
  bool deliverClass(const Pegasus::CIMClass& declaration) override {
    any_ = true;
    return writer_->deliverClass(declaration);
  }
  bool deliverClassName(const Pegasus::CIMName& name) override {
    any_ = true;
    return writer_->deliverClassName(name);
  }
  void finish() override { writer_->finish(); }

  bool any() const { return any_; }

 private:
  std::unique_ptr<ResultWriter> writer_;
  bool any_ = false;
};

InstanceSelection selectionOf(const CommandLine& line) {
  return {line.deep, line.localOnly, line.includeQualifiers, line.includeClassOrigin,
          line.properties};
}

std::string userName() {
  const char* name = getlogin();
  return name != nullptr ? name : std::to_string(getuid());
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

OperationStatus runOperationCommand(const CommandLine& line, const Operations& operations,
                                    ResultWriter& writer) {
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
    case Command::declaration:
      return operations.getClass({nameSpace, className, line.localOnly, line.includeQualifiers,
                                  line.includeClassOrigin, line.properties},
                                 writer);
    case Command::classes:
      return listClasses(line, operations, writer);
    case Command::check:
      break;
  }
  return {};
}

std::string counted(std::ptrdiff_t count, const std::string& noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

}  // namespace

bool needsProvider(Command command) {
  return command == Command::enumerate || command == Command::names || command == Command::get;
}

int runCommand(const CommandLine& line, const Host& host, std::ostream& out, std::ostream& error) {
  if (line.command == Command::check) return runCheck(host, out);
  for (const Diagnostic& problem : host.diagnostics()) error << problem.toString() << '\n';
  const bool single = line.command == Command::get || line.command == Command::declaration;
  CountingWriter writer(
      makeResultWriter(line.format, out, single ? ResultForm::single : ResultForm::list));
  const OperationStatus status = runOperationCommand(line, host.operations(), writer);
  if (status.ok() || writer.any()) writer.finish();
  if (!status.ok()) {
    error << "cimhost: " << displayText(status.toString()) << '\n';
    return ExitCode::kOperation + static_cast<int>(status.code);
  }
  if (!out) {
    error << "cimhost: the results could not be written\n";
    return ExitCode::kOutput;
  }
  return ExitCode::kOk;
}

int runCheck(const Host& host, std::ostream& out) {
  const std::vector<Diagnostic>& problems = host.diagnostics();
  for (const Diagnostic& problem : problems) out << problem.toString() << '\n';
  const auto errors = std::count_if(problems.begin(), problems.end(), [](const Diagnostic& each) {
    return each.severity == Diagnostic::Severity::error;
  });
  const auto warnings = static_cast<std::ptrdiff_t>(problems.size()) - errors;
  const auto served = static_cast<std::ptrdiff_t>(host.served().all().size());
  out << counted(served, "definition") << ", " << counted(errors, "error") << ", "
      << counted(warnings, "warning") << std::endl;
  if (!out) return ExitCode::kOutput;
  return errors > 0 ? ExitCode::kProblems : ExitCode::kOk;
}

}  // namespace cimhost
