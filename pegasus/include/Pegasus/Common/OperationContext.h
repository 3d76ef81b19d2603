// What accompanies an operation on its way through the server.
#pragma once

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/Exception.h>
#include <Pegasus/Common/String.h>

#include <vector>

PEGASUS_NAMESPACE_BEGIN

/// A set of containers, each under its own name (compared exactly). Copying clones them all.
class PEGASUS_COMMON_LINKAGE OperationContext {
 public:
  class PEGASUS_COMMON_LINKAGE Container {
   public:
    virtual ~Container();
    virtual String getName() const = 0;
    /// A new container that its owner gives back with destroy().
    virtual Container* clone() const = 0;
    virtual void destroy() = 0;
  };

  OperationContext();
  OperationContext(const OperationContext& context);
  virtual ~OperationContext();
  OperationContext& operator=(const OperationContext& context);

  void clear();
  /// Throws Exception "object not found"; so do set and remove.
  const Container& get(const String& containerName) const;
  Boolean contains(const String& containerName) const;
  /// Replaces the container of the same name by a clone of this one.
  void set(const Container& container);
  /// Keeps a clone. Throws Exception "object already exists." when the name is in use.
  void insert(const Container& container);
  void remove(const String& containerName);

 private:
  std::size_t indexOf(const String& containerName) const;
  std::size_t requiredIndexOf(const String& containerName) const;

  std::vector<Container*> containers_;
};

/// The name of the user on whose behalf the operation runs.
class PEGASUS_COMMON_LINKAGE IdentityContainer : virtual public OperationContext::Container {
 public:
  static const String NAME;

  /// Throws DynamicCastFailedException when the container is of another kind.
  IdentityContainer(const OperationContext::Container& container);
  IdentityContainer(const IdentityContainer& container);
  IdentityContainer(const String& userName);
  ~IdentityContainer() override;
  IdentityContainer& operator=(const IdentityContainer& container);

  String getName() const override;
  OperationContext::Container* clone() const override;
  void destroy() override;
  String getUserName() const;

 private:
  String userName_;
};

PEGASUS_NAMESPACE_END
