#include "cimhost/mof/MofReader.h"

#include "cimhost/Text.h"
#include "cimhost/mof/MofCompiler.h"
#include "cimhost/mof/MofDirectoryReader.h"
#include "cimhost/mof/MofUnit.h"
#include "cimhost/mof/MofValue.h"

namespace cimhost {

MofReader::MofReader(ClassRepository& repository) : repository_(repository) {}

bool MofReader::readFile(const std::string& path, const Pegasus::CIMNamespaceName& nameSpace) {
  try {
    return readSource(readMofFile(path), nameSpace);
  } catch (const std::runtime_error& error) {
    diagnostics_.push_back(wholeFileDiagnostic(path, error.what()));
    return false;
  }
}

bool MofReader::readText(const std::string& text, const std::string& name,
                         const Pegasus::CIMNamespaceName& nameSpace) {
  return readSource(std::make_shared<const MofSource>(MofSource{name, text}), nameSpace);
}

bool MofReader::readDirectory(const std::string& directory,
                              const Pegasus::CIMNamespaceName& defaultNameSpace) {
  return MofDirectoryReader(repository_, diagnostics_).read(directory, defaultNameSpace);
}

bool MofReader::readSource(MofSourcePtr source, const Pegasus::CIMNamespaceName& nameSpace) {
  MofFileSet files;
  const std::string name = source->name;
  MofUnit unit(std::move(source), nameSpace, files);
  MofCompiler compiler(repository_);
  try {
    repository_.addNamespace(nameSpace);
    while (const auto item = unit.next()) compiler.add(*item);
    return true;
  } catch (const MofError& error) {
    diagnostics_.push_back(error.diagnostic());
  } catch (const Pegasus::Exception& exception) {
    diagnostics_.push_back(wholeFileDiagnostic(name, toUtf8(exception.getMessage())));
  }
  return false;
}

}  // namespace cimhost
