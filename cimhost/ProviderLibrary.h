#pragma once

#include <Pegasus/Provider/CIMAssociationProvider.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>
#include <Pegasus/Provider/CIMMethodProvider.h>
#include <Pegasus/Provider/CIMOMHandle.h>

#include <string>

namespace cimhost {

/// A provider library in use, as a CIM server uses it: opened with the loader, asked for its
/// provider object at the entry point PegasusCreateProvider, initialised; terminated and closed at
/// the end.
///
/// load() and unload() belong to one thread, while no operation runs. The interfaces may be used
/// from several threads at once between the two. The provider object is never deleted here:
/// terminate() ends its life.
class ProviderLibrary {
 public:
  ProviderLibrary() = default;
  /// As unload(), but a failure of terminate() is dropped.
  ~ProviderLibrary();
  ProviderLibrary(const ProviderLibrary&) = delete;
  ProviderLibrary& operator=(const ProviderLibrary&) = delete;

  /// Opens `file` and initialises the provider named `providerName` with `handle`, which must live
  /// until unload(). Throws HostError and leaves nothing open; a provider whose initialize() throws
  /// is terminated first, as a server does.
  void load(const std::string& file, const std::string& providerName, Pegasus::CIMOMHandle& handle);

  /// Terminates the provider and closes the library; does nothing when none is loaded. Throws
  /// HostError when terminate() threw; the library is closed all the same.
  void unload();

  bool isLoaded() const { return provider_ != nullptr; }

  /// The interfaces of the provider, each null when it has not got it.
  Pegasus::CIMInstanceProvider* instances() const { return instances_; }
  Pegasus::CIMAssociationProvider* associations() const { return associations_; }
  Pegasus::CIMMethodProvider* methods() const { return methods_; }

 private:
  void open(const std::string& file);
  void create(const std::string& file, const std::string& providerName);
  std::string terminateAndClose();

  void* library_ = nullptr;
  Pegasus::CIMProvider* provider_ = nullptr;
  Pegasus::CIMInstanceProvider* instances_ = nullptr;
  Pegasus::CIMAssociationProvider* associations_ = nullptr;
  Pegasus::CIMMethodProvider* methods_ = nullptr;
};

/// The provider library to load: `given` as an absolute path when it is not empty; else the file
/// libCommonProvider.so in ../lib beside the program's folder, in that folder itself, or where it
/// is installed, by its way from the program's folder; else the bare file name, which leaves the
/// search to the loader. Call it before the working directory changes.
std::string findProviderLibrary(const std::string& given);

}  // namespace cimhost
