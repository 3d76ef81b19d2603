#include "cimhost/CommandLine.h"

#include "cimhost/OperationStatus.h"
#include "cimhost/PathArgument.h"
#include "cimhost/ServeArguments.h"
#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <vector>

namespace cimhost {

namespace {

using Command = CommandLine::Command;
using ParseTarget = Pegasus::CIMObjectPath (*)(const std::string&);

constexpr const char* kFooter =
    "Paths are written as root/host:Host_FileSystem.Name=\"/\"\n"
    "\n"
    "Values are written as NAME=VALUE; NAME alone is null. Arrays: NAME=a,b or NAME=[]\n"
    "\n"
    "Exit codes: 0 done; 1 check, registration or dump found errors; 2 usage, malformed path,\n"
    "value that does not fit; 3 home directory, provider library, users, certificate or address\n"
    "unusable; 4 results could not be written; 5 serve: requests did not end in time; 10 + CIM "
    "status code when the operation failed, for example 16 for\n"
    "CIM_ERR_NOT_FOUND.";

struct FormatRow {
  const char* name;
  OutputFormat format;
};

constexpr FormatRow kFormats[] = {{"table", OutputFormat::table},
                                  {"mof", OutputFormat::mof},
                                  {"json", OutputFormat::json},
                                  {"xml", OutputFormat::xml}};

// The texts as given, before they become CIM names.
struct Arguments {
  std::string format = "table";
  std::string target;
  std::vector<std::string> properties;
  std::string associationClass;
  std::string resultClass;
  std::string role;
  std::string resultRole;
  std::string moduleName = "CommonProviderModule";
  std::string vendor = "CommonProvider";
  std::string moduleVersion = COMMONPROVIDER_VERSION;
  std::string location = "CommonProvider";
};

// Groups of options, as bits.
enum Options : unsigned {
  kNone = 0,
  kSelection = 1,   // which parts of instances or classes
  kLocal = 2,       // --local-only
  kInstances = 4,   // --deep, for instances
  kClasses = 8,     // --deep, for classes
  kFilter = 16,     // --result-class and --role
  kFarFilter = 32,  // --assoc-class and --result-role
  kValues = 64,     // NAME=VALUE..., at least one
  kMethod = 128,    // METHOD [NAME=VALUE...]
  kFiles = 256,     // [FILE...]
  kModule = 512,    // what a registration says of the provider module
  kServe = 1024     // what a server is to do
};

struct CommandRow {
  Command command;
  const char* name;
  const char* description;
  const char* argument;  // Null: takes none.
  ParseTarget parse;
  unsigned options;
};

constexpr CommandRow kCommands[] = {
    {Command::enumerate, "enumerate", "Instances of a class and its subclasses", "NS:CLASS",
     parseClassPath, kSelection | kLocal | kInstances},
    {Command::names, "names", "Object paths of the instances", "NS:CLASS", parseClassPath, kNone},
    {Command::get, "get", "One instance", "PATH", parseInstancePath, kSelection | kLocal},
    {Command::modify, "modify", "Write properties of one instance", "PATH", parseInstancePath,
     kValues},
    {Command::invoke, "invoke", "Call a method of an instance or a class", "PATH", parseObjectPath,
     kMethod},
    {Command::associators, "associators", "Instances that associations link to one instance",
     "PATH", parseInstancePath, kSelection | kFilter | kFarFilter},
    {Command::associatorNames, "associator-names", "Object paths of these instances", "PATH",
     parseInstancePath, kFilter | kFarFilter},
    {Command::references, "references", "Instances of association classes that link one instance",
     "PATH", parseInstancePath, kSelection | kFilter},
    {Command::referenceNames, "reference-names", "Object paths of these instances", "PATH",
     parseInstancePath, kFilter},
    {Command::declaration, "class", "A class declaration", "NS:CLASS", parseClassPath,
     kSelection | kLocal},
    {Command::classes, "classes", "The classes of a namespace, or below a class", "NS[:CLASS]",
     parseNamespaceOrClass, kClasses},
    {Command::qualifiers, "qualifiers", "Print the qualifiers of a namespace as MOF", "NS",
     parseNamespaceOrClass, kNone},
    {Command::check, "check", "Report every problem in the files of the home directory", nullptr,
     nullptr, kNone},
    {Command::registration, "registration",
     "Print the MOF that registers the classes with OpenPegasus", nullptr, nullptr, kModule},
    {Command::dump, "dump", "Print what definition files define; default: all of run/", nullptr,
     nullptr, kFiles},
    {Command::serve, "serve", "Answer CIM operations over HTTP until a signal ends it", nullptr,
     nullptr, kServe}};

CLI::Option* addText(CLI::App& app, const char* name, std::string& value, const char* description,
                     const char* type) {
  return app.add_option(name, value, description)->type_name(type);
}

void addSelectionOptions(CLI::App& app, CommandLine& line, Arguments& arguments) {
  app.add_flag("--qualifiers,!--no-qualifiers", line.includeQualifiers, "Include qualifiers");
  app.add_flag("--class-origin,!--no-class-origin", line.includeClassOrigin,
               "Include class origins");
  app.add_option("--property", arguments.properties, "Only this property; may be repeated")
      ->type_name("NAME")
      ->allow_extra_args(false);
}

void addFilterOptions(CLI::App& app, unsigned options, Arguments& arguments) {
  if ((options & kFarFilter) != 0) {
    addText(app, "--assoc-class", arguments.associationClass,
            "Only along this association class and its subclasses", "CLASS");
    addText(app, "--result-role", arguments.resultRole, "Only results in this role", "NAME");
  }
  addText(app, "--result-class", arguments.resultClass, "Only this class and its subclasses",
          "CLASS");
  addText(app, "--role", arguments.role, "Only where the object itself has this role", "NAME");
}

void addValueArguments(CLI::App& app, unsigned options, CommandLine& line) {
  if ((options & kMethod) != 0) addText(app, "METHOD", line.method, "", "")->required();
  CLI::Option* values =
      app.add_option("NAME=VALUE", line.values, "May be repeated; NAME alone is null")
          ->type_name("");
  if ((options & kValues) != 0) values->required();
}

// A name that can stand in a file name and, unquoted, in a shell command.
std::string plainNameProblem(const std::string& name) {
  const auto isPlain = [](char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_' ||
           c == '.' || c == '-';
  };
  const bool good =
      !name.empty() && name[0] != '-' && std::all_of(name.begin(), name.end(), isPlain);
  return good ? std::string() : "expected letters, digits, '_', '.' and '-'";
}

void addModuleOptions(CLI::App& app, Arguments& arguments) {
  addText(app, "--module-name", arguments.moduleName,
          "Name of the module; default: CommonProviderModule", "NAME")
      ->check(plainNameProblem);
  addText(app, "--location", arguments.location,
          "The library is lib + NAME + .so; default: CommonProvider", "NAME")
      ->check(plainNameProblem);
  addText(app, "--vendor", arguments.vendor, "Default: CommonProvider", "TEXT");
  addText(app, "--module-version", arguments.moduleVersion, "Default: that of cimhost", "TEXT");
}

void addCommand(CLI::App& app, const CommandRow& row, CommandLine& line, Arguments& arguments) {
  CLI::App& command = *app.add_subcommand(row.name, row.description);
  command.fallthrough();
  command.callback([&line, &row] { line.command = row.command; });
  if (row.argument != nullptr) {
    addText(command, row.argument, arguments.target, "", "")->required();
  }
  if ((row.options & kLocal) != 0) {
    command.add_flag("--local-only,!--no-local-only", line.localOnly,
                     "Leave out properties that the class inherits");
  }
  if ((row.options & kSelection) != 0) addSelectionOptions(command, line, arguments);
  if ((row.options & (kInstances | kClasses)) != 0) {
    command.add_flag("--deep,!--no-deep", line.deep,
                     (row.options & kInstances) != 0
                         ? "Include properties of subclasses (default)"
                         : "Include subclasses of subclasses (default)");
  }
  if ((row.options & (kFilter | kFarFilter)) != 0) {
    addFilterOptions(command, row.options, arguments);
  }
  if ((row.options & (kValues | kMethod)) != 0) addValueArguments(command, row.options, line);
  if ((row.options & kFiles) != 0) command.add_option("FILE", line.files)->type_name("");
  if ((row.options & kModule) != 0) addModuleOptions(command, arguments);
  if ((row.options & kServe) != 0) addServeArguments(command, line.serve);
}

void addGlobalOptions(CLI::App& app, CommandLine& line, Arguments& arguments) {
  app.add_option("--home", line.home, "Home directory with run, lib, logs and mof")
      ->required()
      ->type_name("DIR");
  app.add_option("--provider", line.providerFile, "Provider library instead of the one found")
      ->type_name("FILE");
  app.add_option("--format", arguments.format, "How results are printed; default: table")
      ->check(CLI::IsMember({"table", "mof", "json", "xml"}))
      ->type_name("FORMAT");
  app.add_flag("--trace", line.trace, "Show the provider's trace lines on standard error");
}

Pegasus::CIMPropertyList toPropertyList(const std::vector<std::string>& names) {
  if (names.empty()) return {};
  Pegasus::Array<Pegasus::CIMName> list;
  for (const std::string& name : names) list.append(Pegasus::CIMName(fromUtf8(name)));
  return Pegasus::CIMPropertyList(list);
}

Pegasus::CIMName toName(const std::string& name) {
  return name.empty() ? Pegasus::CIMName() : Pegasus::CIMName(fromUtf8(name));
}

// For references the class of the results is that of the associations.
AssociationFilter toFilter(const Arguments& arguments, Command command) {
  AssociationFilter filter{toName(arguments.associationClass), toName(arguments.resultClass),
                           fromUtf8(arguments.role), fromUtf8(arguments.resultRole)};
  if (command == Command::references || command == Command::referenceNames) {
    std::swap(filter.associationClass, filter.resultClass);
  }
  return filter;
}

// Throws PathArgumentError and Pegasus::Exception.
void convertArguments(const Arguments& arguments, CommandLine& line) {
  for (const FormatRow& row : kFormats) {
    if (row.name == arguments.format) line.format = row.format;
  }
  for (const CommandRow& row : kCommands) {
    if (row.command == line.command && row.parse != nullptr) {
      line.target = row.parse(arguments.target);
    }
  }
  line.properties = toPropertyList(arguments.properties);
  line.filter = toFilter(arguments, line.command);
  line.registration = {fromUtf8(arguments.moduleName), fromUtf8(arguments.vendor),
                       fromUtf8(arguments.moduleVersion), fromUtf8(arguments.location)};
}

}  // namespace

std::optional<CommandLine> parseCommandLine(int argc, const char* const* argv, std::ostream& out,
                                            std::ostream& error, int& exitCode) {
  CommandLine line;
  Arguments arguments;
  CLI::App app("Embedded CIM host for provider definitions", "cimhost");
  app.footer(kFooter);
  app.set_version_flag("--version", "cimhost " COMMONPROVIDER_VERSION, "Print the version");
  app.require_subcommand(1);
  addGlobalOptions(app, line, arguments);
  for (const CommandRow& row : kCommands) addCommand(app, row, line, arguments);
  exitCode = ExitCode::kUsage;
  try {
    app.parse(argc, argv);
    if (app.got_subcommand("class") && app.get_subcommand("class")->count("--qualifiers") == 0) {
      line.includeQualifiers = true;
    }
    convertArguments(arguments, line);
    if (line.command == Command::serve) requireUsable(line.serve);
    exitCode = ExitCode::kOk;
    return line;
  } catch (const CLI::ParseError& problem) {
    if (app.exit(problem, out, error) == 0) exitCode = ExitCode::kOk;
  } catch (const PathArgumentError& problem) {
    error << "cimhost: " << problem.what() << '\n';
  } catch (...) {
    error << "cimhost: " << displayText(currentExceptionStatus().message) << '\n';
  }
  return std::nullopt;
}

}  // namespace cimhost
