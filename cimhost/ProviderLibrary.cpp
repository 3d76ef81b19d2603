#include "cimhost/ProviderLibrary.h"

#include "cimhost/HostError.h"
#include "cimhost/OperationStatus.h"
#include "cimhost/Text.h"

#include <dlfcn.h>

#include <filesystem>

namespace cimhost {

namespace {

constexpr const char* kEntryPoint = "PegasusCreateProvider";
constexpr const char* kLibraryFile = "libCommonProvider.so";

// Where the provider library is installed, seen from the program's folder.
constexpr const char* kInstalledFolder = COMMONPROVIDER_INSTALLED_FOLDER;

using CreateProvider = Pegasus::CIMProvider* (*)(const Pegasus::String&);

std::string loaderError() {
  const char* text = dlerror();
  return text != nullptr ? text : "unknown loader error";
}

// The exception object's code may lie in the library: only its text leaves this function, so that
// the library can be closed afterwards. Empty when `call` returned.
template <class Call>
std::string failureOf(Call call) {
  const OperationStatus status = runOperation(call);
  if (status.ok()) return {};
  return status.message.empty() ? status.name() : status.message;
}

}  // namespace

ProviderLibrary::~ProviderLibrary() {
  terminateAndClose();
}

void ProviderLibrary::load(const std::string& file, const std::string& providerName,
                           Pegasus::CIMOMHandle& handle) {
  unload();
  open(file);
  create(file, providerName);
  const std::string failure = failureOf([&] { provider_->initialize(handle); });
  if (failure.empty()) return;
  terminateAndClose();
  throw HostError(file + ": provider initialization failed: " + failure);
}

void ProviderLibrary::unload() {
  const std::string failure = terminateAndClose();
  if (!failure.empty()) throw HostError("provider termination failed: " + failure);
}

void ProviderLibrary::open(const std::string& file) {
  library_ = dlopen(file.c_str(), RTLD_NOW);
  if (library_ == nullptr) throw HostError("cannot load the provider library: " + loaderError());
}

void ProviderLibrary::create(const std::string& file, const std::string& providerName) {
  const auto entry = reinterpret_cast<CreateProvider>(dlsym(library_, kEntryPoint));
  std::string failure;
  if (entry == nullptr) {
    failure = std::string("no entry point ") + kEntryPoint;
  } else {
    failure = failureOf([&] { provider_ = entry(fromUtf8(providerName)); });
    if (failure.empty() && provider_ == nullptr) failure = "no provider named " + providerName;
  }
  if (!failure.empty()) {
    terminateAndClose();
    throw HostError(file + ": " + failure);
  }
  instances_ = dynamic_cast<Pegasus::CIMInstanceProvider*>(provider_);
  associations_ = dynamic_cast<Pegasus::CIMAssociationProvider*>(provider_);
  methods_ = dynamic_cast<Pegasus::CIMMethodProvider*>(provider_);
}

std::string ProviderLibrary::terminateAndClose() {
  std::string failure;
  if (provider_ != nullptr) failure = failureOf([this] { provider_->terminate(); });
  // terminate() usually deletes the provider: nothing of it is touched from here on.
  provider_ = nullptr;
  instances_ = nullptr;
  associations_ = nullptr;
  methods_ = nullptr;
  if (library_ != nullptr) dlclose(library_);
  library_ = nullptr;
  return failure;
}

std::string findProviderLibrary(const std::string& given) {
  namespace fs = std::filesystem;
  std::error_code error;
  if (!given.empty()) {
    const fs::path absolute = fs::absolute(given, error);
    return error ? given : absolute.string();
  }
  const fs::path program = fs::read_symlink("/proc/self/exe", error);
  if (!error) {
    const fs::path folder = program.parent_path();
    for (const fs::path& place : {fs::path("../lib"), fs::path(), fs::path(kInstalledFolder)}) {
      const fs::path candidate = (folder / place / kLibraryFile).lexically_normal();
      if (fs::is_regular_file(candidate, error)) return candidate.string();
    }
  }
  return kLibraryFile;
}

}  // namespace cimhost
