#pragma once

#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefValue.h"

#include <string>

class ElementReader;

/// How one property of a class is read and written.
class ProviderDefProperty {
 public:
  /// Builds the property from its `property` element; see ProviderDefModule for the arguments.
  ProviderDefProperty(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefProperty(ElementReader& reader, ProviderDefModule* module);

  const std::string& getName() const { return name_; }
  /// True when the value read is turned into a text through ValueMap and Values qualifiers.
  bool getGetValuemap() const { return getValuemap_; }
  /// The CIM property that carries these qualifiers. No attribute fills it: always empty.
  const std::string& getGetValuemapProperty() const { return getValuemapProperty_; }

  /// The value of the instance `index`: the get call's, or the constant for every index.
  ProviderDefValue getValue(int index) const;
  /// Writes through the set call; 0 when the property has none.
  int setValue(const ProviderDefValue& value, int index) const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  void read(ElementReader& reader, ProviderDefModule* module);
  void readGet(ElementReader& reader, ProviderDefModule* module);
  void readSet(ElementReader& reader, ProviderDefModule* module);

  bool hasSet_ = false;
  bool getFromFunction_ = false;
  bool setFromFunction_ = false;
  ProviderDefFunctionCall getCall_;
  ProviderDefFunctionCall setCall_;
  bool getValuemap_ = false;
  std::string getValuemapProperty_;
  ProviderDefValue getConstant_;
  ProviderDefValue setConstant_;
  std::string name_;
};
