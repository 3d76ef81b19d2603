#include "cimhost/CommandLine.h"

#include "cimhost/OperationStatus.h"
#include "cimhost/PathArgument.h"
#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

#include <CLI/CLI.hpp>

#include <vector>

namespace cimhost {

namespace {

using Command = CommandLine::Command;
using ParseTarget = Pegasus::CIMObjectPath (*)(const std::string&);

constexpr const char* kFooter =
    "Paths are written as root/host:Host_FileSystem.Name=\"/\"\n"
    "\n"
    "Exit codes: 0 done; 1 check found errors; 2 usage or malformed path; 3 home directory or\n"
    "provider library unusable; 4 results could not be written; 10 + CIM status code when the\n"
    "operation failed, for example 16 for CIM_ERR_NOT_FOUND.";

struct FormatRow {
  const char* name;
  OutputFormat format;
};

constexpr FormatRow kFormats[] = {
    {"table", OutputFormat::table}, {"mof", OutputFormat::mof}, {"json", OutputFormat::json}};

// The texts as given, before they become CIM names.
struct Arguments {
  std::string format = "table";
  std::string target;
  std::vector<std::string> properties;
};

struct CommandRow {
  Command command;
  const char* name;
  const char* description;
  const char* argument;  // Null: takes none.
  ParseTarget parse;
};

constexpr CommandRow kCommands[] = {
    {Command::enumerate, "enumerate", "Instances of a class and its subclasses", "NS:CLASS",
     parseClassPath},
    {Command::names, "names", "Object paths of the instances", "NS:CLASS", parseClassPath},
    {Command::get, "get", "One instance", "PATH", parseInstancePath},
    {Command::declaration, "class", "A class declaration", "NS:CLASS", parseClassPath},
    {Command::classes, "classes", "The classes of a namespace, or below a class", "NS[:CLASS]",
     parseNamespaceOrClass},
    {Command::check, "check", "Report every problem in the files of the home directory", nullptr,
     nullptr}};

void addInstanceOptions(CLI::App& app, CommandLine& line, Arguments& arguments) {
  app.add_flag("--local-only,!--no-local-only", line.localOnly,
               "Leave out properties that the class inherits");
  app.add_flag("--qualifiers,!--no-qualifiers", line.includeQualifiers, "Include qualifiers");
  app.add_flag("--class-origin,!--no-class-origin", line.includeClassOrigin,
               "Include class origins");
  app.add_option("--property", arguments.properties, "Only this property; may be repeated")
      ->type_name("NAME")
      ->allow_extra_args(false);
}

void addCommand(CLI::App& app, const CommandRow& row, CommandLine& line, Arguments& arguments) {
  CLI::App& command = *app.add_subcommand(row.name, row.description);
  command.fallthrough();
  command.callback([&line, &row] { line.command = row.command; });
  if (row.argument == nullptr) return;
  command.add_option(row.argument, arguments.target)->required()->type_name("");
  const bool instances = row.command == Command::enumerate || row.command == Command::get;
  if (instances || row.command == Command::declaration)
    addInstanceOptions(command, line, arguments);
  if (row.command == Command::enumerate || row.command == Command::classes) {
    command.add_flag("--deep,!--no-deep", line.deep,
                     row.command == Command::enumerate
                         ? "Include properties of subclasses (default)"
                         : "Include subclasses of subclasses (default)");
  }
}

void addGlobalOptions(CLI::App& app, CommandLine& line, Arguments& arguments) {
  app.add_option("--home", line.home, "Home directory with run, lib, logs and mof")
      ->required()
      ->type_name("DIR");
  app.add_option("--provider", line.providerFile, "Provider library instead of the one found")
      ->type_name("FILE");
  app.add_option("--format", arguments.format, "How results are printed; default: table")
      ->check(CLI::IsMember({"table", "mof", "json"}))
      ->type_name("FORMAT");
  app.add_flag("--trace", line.trace, "Show the provider's trace lines on standard error");
}

Pegasus::CIMPropertyList toPropertyList(const std::vector<std::string>& names) {
  if (names.empty()) return {};
  Pegasus::Array<Pegasus::CIMName> list;
  for (const std::string& name : names) list.append(Pegasus::CIMName(fromUtf8(name)));
  return Pegasus::CIMPropertyList(list);
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
}

}  // namespace

std::optional<CommandLine> parseCommandLine(int argc, const char* const* argv, std::ostream& out,
                                            std::ostream& error, int& exitCode) {
  CommandLine line;
  Arguments arguments;
  CLI::App app("Embedded CIM host for provider definitions", "cimhost");
  app.footer(kFooter);
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
