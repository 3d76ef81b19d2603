#pragma once

#include "ProviderTest.h"

/// Items and parts of the plug-in's two tables, foreign volumes of the host, and an association
/// between them: an item goes with the parts and volumes whose Owner is its Name.
class LinkTest : public ProviderTest {
 protected:
  static std::string pairOf(const std::string& first, const std::string& firstProperty,
                            const std::string& second, const std::string& secondProperty,
                            const std::string& condition = "<equal>0 0</equal>") {
    const auto side = [](const std::string& name, const std::string& propertyName) {
      return "<classname name=\"" + name + "\"><propertyname name=\"" + propertyName +
             "\"/></classname>";
    };
    return side(first, firstProperty) + side(second, secondProperty) + "<condition>" + condition +
           "</condition>";
  }

  static std::string association(const std::string& name, const std::string& pairs) {
    return "<association name=\"" + name +
           "\" namespace2=\"root/t\" propertyname1=\"Item\" propertyname2=\"Part\">" + pairs +
           "</association>";
  }

  static std::string classes() {
    return itemClass() + definedClass("T_Part", call("rightCount", "getI", ""),
                                      property("Id", constant("indexstring", "p")) +
                                          property("Owner", call("rightText", "getSi")));
  }

  static std::string itemsAndParts() { return pairOf("T_Item", "Name", "T_Part", "Owner"); }
  static std::string itemsAndVolumes() { return pairOf("T_Item", "Name", "T_Volume", "Owner"); }

  void addVolume(const char* id, const char* owner) {
    CIMInstance volume(CIMName("T_Volume"));
    volume.addProperty(CIMProperty(CIMName("Owner"), String(owner)));
    volume.setPath(pathOf((std::string("T_Volume.Id=") + id).c_str()));
    host.add(volume);
  }

  void SetUp() override {
    host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
    host.add(makeClass(
        "T_Part", {declared("Id", CIMTYPE_STRING, Key::kYes), declared("Owner", CIMTYPE_STRING)}));
    for (const char* name : {"T_Link", "T_Other"}) {
      host.add(makeClass(name, {declared("Part", CIMTYPE_REFERENCE, Key::kYes),
                                declared("Item", CIMTYPE_REFERENCE, Key::kYes)}));
    }
    setTable(state->left, {"a", "b"});
    setTable(state->right, {"b", "a", "b", "z"});
    addVolume("1", "a");
    addVolume("2", "z");
  }
};
