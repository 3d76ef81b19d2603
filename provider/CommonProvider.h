#pragma once

#include "association/ProviderDefAssociation.h"
#include "engine/ProviderDefClass.h"

#include <Pegasus/Provider/CIMAssociationProvider.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>
#include <Pegasus/Provider/CIMMethodProvider.h>

#include <string>

namespace Vaneth {

/// The provider object that the CIM server creates: serves every class that the definition files of
/// the working directory declare.
///
/// The definitions live in process-wide registries, not in the object. Operations may be called
/// from several threads at once, between initialize() and terminate(). Nothing is kept between
/// requests: each one evaluates the definitions anew.
///
/// Unknown classes, methods and instances are no errors: the operation ends quietly. The only
/// CIMException thrown is CIM_ERR_NOT_SUPPORTED.
class CommonProvider : public Pegasus::CIMInstanceProvider,
                       public Pegasus::CIMAssociationProvider,
                       public Pegasus::CIMMethodProvider {
 public:
  CommonProvider();
  ~CommonProvider() override;

  /// Keeps the handle's address and reads every file of the working directory whose name contains
  /// ".xml", in directory order.
  void initialize(Pegasus::CIMOMHandle& cimom) override;

  /// Releases the definitions and closes the plug-in libraries, then deletes this object.
  void terminate() override;

  void getInstance(const Pegasus::OperationContext& context,
                   const Pegasus::CIMObjectPath& instanceReference,
                   const Pegasus::Boolean includeQualifiers,
                   const Pegasus::Boolean includeClassOrigin,
                   const Pegasus::CIMPropertyList& propertyList,
                   Pegasus::InstanceResponseHandler& handler) override;

  /// Delivers the instances of a defined class, one for each index, or those of an association
  /// class, one for each related pair. The flags and the property list are ignored.
  void enumerateInstances(const Pegasus::OperationContext& context,
                          const Pegasus::CIMObjectPath& classReference,
                          const Pegasus::Boolean includeQualifiers,
                          const Pegasus::Boolean includeClassOrigin,
                          const Pegasus::CIMPropertyList& propertyList,
                          Pegasus::InstanceResponseHandler& handler) override;

  void enumerateInstanceNames(const Pegasus::OperationContext& context,
                              const Pegasus::CIMObjectPath& classReference,
                              Pegasus::ObjectPathResponseHandler& handler) override;

  /// Writes the properties that both the definition and the instance have. Which ones failed is
  /// told by the log alone.
  void modifyInstance(const Pegasus::OperationContext& context,
                      const Pegasus::CIMObjectPath& instanceReference,
                      const Pegasus::CIMInstance& instanceObject,
                      const Pegasus::Boolean includeQualifiers,
                      const Pegasus::CIMPropertyList& propertyList,
                      Pegasus::ResponseHandler& handler) override;

  /// Always refused, as deleteInstance is: instances come from the definitions alone.
  void createInstance(const Pegasus::OperationContext& context,
                      const Pegasus::CIMObjectPath& instanceReference,
                      const Pegasus::CIMInstance& instanceObject,
                      Pegasus::ObjectPathResponseHandler& handler) override;
  void deleteInstance(const Pegasus::OperationContext& context,
                      const Pegasus::CIMObjectPath& instanceReference,
                      Pegasus::ResponseHandler& handler) override;

  void associators(const Pegasus::OperationContext& context,
                   const Pegasus::CIMObjectPath& objectName,
                   const Pegasus::CIMName& associationClass, const Pegasus::CIMName& resultClass,
                   const Pegasus::String& role, const Pegasus::String& resultRole,
                   const Pegasus::Boolean includeQualifiers,
                   const Pegasus::Boolean includeClassOrigin,
                   const Pegasus::CIMPropertyList& propertyList,
                   Pegasus::ObjectResponseHandler& handler) override;

  /// Delivers the paths of the objects that association definitions link to the object. Roles are
  /// ignored. CIM_ERR_NOT_SUPPORTED when no definition matches the classes.
  void associatorNames(const Pegasus::OperationContext& context,
                       const Pegasus::CIMObjectPath& objectName,
                       const Pegasus::CIMName& associationClass,
                       const Pegasus::CIMName& resultClass, const Pegasus::String& role,
                       const Pegasus::String& resultRole,
                       Pegasus::ObjectPathResponseHandler& handler) override;

  /// Always refused, as referenceNames is.
  void references(const Pegasus::OperationContext& context,
                  const Pegasus::CIMObjectPath& objectName, const Pegasus::CIMName& resultClass,
                  const Pegasus::String& role, const Pegasus::Boolean includeQualifiers,
                  const Pegasus::Boolean includeClassOrigin,
                  const Pegasus::CIMPropertyList& propertyList,
                  Pegasus::ObjectResponseHandler& handler) override;
  void referenceNames(const Pegasus::OperationContext& context,
                      const Pegasus::CIMObjectPath& objectName, const Pegasus::CIMName& resultClass,
                      const Pegasus::String& role,
                      Pegasus::ObjectPathResponseHandler& handler) override;

  void invokeMethod(const Pegasus::OperationContext& context,
                    const Pegasus::CIMObjectPath& objectReference,
                    const Pegasus::CIMName& methodName,
                    const Pegasus::Array<Pegasus::CIMParamValue>& inParameters,
                    Pegasus::MethodResultResponseHandler& handler) override;

 private:
  using Instances = Pegasus::Array<Pegasus::CIMInstance>;

  void enumerateDefined(const Pegasus::OperationContext& context,
                        const Pegasus::CIMObjectPath& classReference,
                        const ProviderDefClass& definition,
                        Pegasus::InstanceResponseHandler& handler);
  void enumerateAssociation(const Pegasus::OperationContext& context,
                            const Pegasus::CIMObjectPath& classReference,
                            const ProviderDefAssociation& association,
                            Pegasus::InstanceResponseHandler& handler);
  Pegasus::CIMInstance buildAssociationInstance(const Pegasus::OperationContext& context,
                                                const Pegasus::CIMObjectPath& classReference,
                                                const ProviderDefAssociation& association,
                                                const Pegasus::CIMObjectPath& first,
                                                const Pegasus::CIMObjectPath& second);

  /// Writes the property at `position` of the class, if the definition and `sent` have it.
  void writeProperty(const ProviderDefClass& definition, Pegasus::CIMClass& cimClass,
                     Pegasus::Uint32 position, const Pegasus::CIMInstance& sent, int index);

  /// Delivers the paths of the `targetClass` instances that one association links to `object`.
  void deliverTargets(const Pegasus::OperationContext& context,
                      const Pegasus::CIMNamespaceName& nameSpace,
                      const Pegasus::CIMObjectPath& object,
                      const ProviderDefAssociation& association, const std::string& objectClass,
                      const std::string& targetClass, Pegasus::ObjectPathResponseHandler& handler);

  /// The class with qualifiers and class origins, a fresh object.
  Pegasus::CIMClass fetchClass(const Pegasus::OperationContext& context,
                               const Pegasus::CIMObjectPath& path);

  /// The instances of one class of this provider's own.
  Instances enumerateOwn(const Pegasus::OperationContext& context,
                         const Pegasus::CIMNamespaceName& nameSpace,
                         const Pegasus::CIMName& className, bool includeQualifiers,
                         bool includeClassOrigin);

  /// The instances of any class: this provider's own, or the server's. `trace` is the text that is
  /// logged at level 7, with the class name in it, when the server is asked.
  Instances enumerateAny(const Pegasus::OperationContext& context,
                         const Pegasus::CIMNamespaceName& nameSpace, const std::string& className,
                         const std::string& trace);

  /// Where an instance stands in its class's enumeration.
  struct Place {
    bool found;
    int index;  ///< Behind the last instance when it was not found.
  };

  /// The place of the instance that `reference` names. Host and namespace do not matter.
  Place findPlace(const Pegasus::OperationContext& context,
                  const Pegasus::CIMObjectPath& reference);

  Pegasus::CIMOMHandle* cimom_ = nullptr;  // the server's; not owned
};

/// The path without host and namespace, which never tell instances apart here.
Pegasus::CIMObjectPath withoutPlace(const Pegasus::CIMObjectPath& path);

/// True when two lists of key bindings name the same instance.
///
/// Compared position by position: equal types, equal names ignoring letter case, then references by
/// their own key bindings (host, namespace and class do not matter), other values exactly by the
/// server's rules. Lists of different sizes differ. Throws MalformedObjectNameException for a
/// reference that is no object path.
bool compareBindings(const Pegasus::Array<Pegasus::CIMKeyBinding>& a,
                     const Pegasus::Array<Pegasus::CIMKeyBinding>& b);

}  // namespace Vaneth

/// The server's way in: a new provider for "CommonProvider" in any letter case, else nullptr.
extern "C" PEGASUS_EXPORT Pegasus::CIMProvider* PegasusCreateProvider(
    const Pegasus::String& providerName);
