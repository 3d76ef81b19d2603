#pragma once

#include <Pegasus/Common/CIMName.h>

PEGASUS_NAMESPACE_BEGIN

class CIMValue;
struct CIMObjectPathRep;

/// One key of an instance: its name and its value as text.
class PEGASUS_COMMON_LINKAGE CIMKeyBinding {
 public:
  enum Type { BOOLEAN = 0, STRING = 1, NUMERIC = 2, REFERENCE = 3 };

  CIMKeyBinding();
  CIMKeyBinding(const CIMName& name, const String& value, Type type);
  /// The text of `value`, and the type that belongs to it; throws TypeMismatchException for arrays,
  /// objects and instances.
  CIMKeyBinding(const CIMName& name, const CIMValue& value);

  const CIMName& getName() const;
  void setName(const CIMName& name);
  const String& getValue() const;
  void setValue(const String& value);
  Type getType() const;
  void setType(Type type);

  /// Whether the text, read as a value of `value`'s type, is `value`.
  Boolean equal(CIMValue value);

 private:
  CIMName name_;
  String value_;
  Type type_;
};

/// Names ignoring case, then types, then values: STRING exactly, BOOLEAN ignoring case, NUMERIC as
/// integers where both are (otherwise exactly), REFERENCE as object paths where both are.
PEGASUS_COMMON_LINKAGE bool operator==(const CIMKeyBinding& x, const CIMKeyBinding& y);

/// The path of a class or instance: `//host/namespace:Class.key=value,...` (DMTF DSP0004).
///
/// Key bindings are kept sorted by name, ignoring case, whatever order they are given in. The value
/// of a REFERENCE binding is parsed and rewritten in canonical form when the binding is set. A
/// text, host or reference that is not well formed throws MalformedObjectNameException. A copy
/// shares its content until one of the two is changed.
class PEGASUS_COMMON_LINKAGE CIMObjectPath {
 public:
  CIMObjectPath();
  CIMObjectPath(const CIMObjectPath& x);
  CIMObjectPath(CIMObjectPath&& x) noexcept;
  CIMObjectPath(const String& objectName);
  CIMObjectPath(const String& host, const CIMNamespaceName& nameSpace, const CIMName& className,
                const Array<CIMKeyBinding>& keyBindings = Array<CIMKeyBinding>());
  ~CIMObjectPath();
  CIMObjectPath& operator=(const CIMObjectPath& x);
  CIMObjectPath& operator=(CIMObjectPath&& x) noexcept;
  CIMObjectPath& operator=(const String& objectName);

  void clear();
  void set(const String& host, const CIMNamespaceName& nameSpace, const CIMName& className,
           const Array<CIMKeyBinding>& keyBindings = Array<CIMKeyBinding>());
  /// Leaves the path empty when it throws.
  void set(const String& objectName);

  // The references are valid until the next change of this object.
  const String& getHost() const;
  void setHost(const String& host);
  const CIMNamespaceName& getNameSpace() const;
  void setNameSpace(const CIMNamespaceName& nameSpace);
  const CIMName& getClassName() const;
  void setClassName(const CIMName& className);
  const Array<CIMKeyBinding>& getKeyBindings() const;
  void setKeyBindings(const Array<CIMKeyBinding>& keyBindings);

  String toString() const;
  Boolean identical(const CIMObjectPath& x) const;
  /// Equal for identical paths.
  Uint32 makeHashCode() const;

 private:
  explicit CIMObjectPath(CIMObjectPathRep* rep);
  CIMObjectPathRep* makeUnique();

  CIMObjectPathRep* rep_;
};

PEGASUS_COMMON_LINKAGE bool operator==(const CIMObjectPath& x, const CIMObjectPath& y);
PEGASUS_COMMON_LINKAGE bool operator!=(const CIMObjectPath& x, const CIMObjectPath& y);

PEGASUS_NAMESPACE_END
