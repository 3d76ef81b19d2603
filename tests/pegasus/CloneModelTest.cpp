// Random changes through old and new handles, against a model that copies everything at once.
#include <Pegasus/Common/CIMClass.h>
#include <gtest/gtest.h>

#include <memory>
#include <random>
#include <string>
#include <vector>

using namespace Pegasus;

namespace {

struct ModelQualifier {
  Uint32 value;
  std::string name;
};
using QualifierPtr = std::shared_ptr<ModelQualifier>;

/// A property, a method or a parameter: a number (where there is one), qualifiers and parts.
struct ModelElement {
  Uint32 value = 0;
  std::vector<QualifierPtr> qualifiers;
  std::vector<std::shared_ptr<ModelElement>> parts;
};
using ElementPtr = std::shared_ptr<ModelElement>;

ElementPtr deepCopy(const ElementPtr& source) {
  auto copy = std::make_shared<ModelElement>();
  copy->value = source->value;
  for (const auto& q : source->qualifiers) {
    copy->qualifiers.push_back(std::make_shared<ModelQualifier>(*q));
  }
  for (const auto& part : source->parts) copy->parts.push_back(deepCopy(part));
  return copy;
}

struct ModelClass {
  std::vector<ElementPtr> properties, methods;

  ModelClass clone() const {
    ModelClass copy;
    for (const auto& p : properties) copy.properties.push_back(deepCopy(p));
    for (const auto& m : methods) copy.methods.push_back(deepCopy(m));
    return copy;
  }
};

template <class Object, class Model>
struct Pair {
  Object object;
  Model model;
};

void print(std::string& out, const CIMConstQualifier& q) {
  const CString name = q.getName().getString().getCString();
  Uint32 value = 0;
  q.getValue().get(value);
  out += "[" + std::string(name) + std::to_string(value) + "]";
}

template <class Reader>
void printQualifiers(std::string& out, const Reader& owner) {
  for (Uint32 i = 0; i < owner.getQualifierCount(); ++i) print(out, owner.getQualifier(i));
}

std::string print(const CIMConstClass& cls) {
  std::string out;
  for (Uint32 i = 0; i < cls.getPropertyCount(); ++i) {
    const CIMConstProperty p = cls.getProperty(i);
    Uint32 value = 0;
    p.getValue().get(value);
    out += " p" + std::to_string(value);
    printQualifiers(out, p);
  }
  for (Uint32 i = 0; i < cls.getMethodCount(); ++i) {
    const CIMConstMethod m = cls.getMethod(i);
    out += " m";
    printQualifiers(out, m);
    for (Uint32 j = 0; j < m.getParameterCount(); ++j) {
      out += " a";
      printQualifiers(out, m.getParameter(j));
    }
  }
  return out;
}

void print(std::string& out, const char* prefix, const ElementPtr& element) {
  out += prefix;
  for (const auto& q : element->qualifiers) {
    out += "[" + q->name + std::to_string(q->value) + "]";
  }
  for (const auto& part : element->parts) print(out, " a", part);
}

std::string print(const ModelClass& cls) {
  std::string out;
  for (const auto& p : cls.properties) print(out, (" p" + std::to_string(p->value)).c_str(), p);
  for (const auto& m : cls.methods) print(out, " m", m);
  return out;
}

class Walk {
 public:
  explicit Walk(unsigned seed) : random_(seed) { classes_.push_back(freshClass()); }

  void step() {
    switch (below(9)) {
      case 0:
        if (classes_.size() < 6) cloneClass();
        break;
      case 1:
        if (classes_.size() > 2) classes_.erase(classes_.begin() + below(classes_.size()));
        break;
      case 2:
      case 3:
        takeHandle();
        break;
      case 4:
        if (!held_.empty()) held_.erase(held_.begin() + below(held_.size()));
        break;
      case 5:
        addQualifier();
        break;
      case 6:
        removeQualifier();
        break;
      case 7:
        setPropertyValue();
        break;
      default:
        changeThroughHandle();
    }
  }

  void check() const {
    for (const auto& c : classes_) ASSERT_EQ(print(CIMConstClass(c.object)), print(c.model));
    for (const auto& h : held_) {
      std::string actual;
      print(actual, h.object);
      ASSERT_EQ(actual, "[" + h.model->name + std::to_string(h.model->value) + "]");
    }
  }

 private:
  using Class = Pair<CIMClass, ModelClass>;
  using Qualifier = Pair<CIMQualifier, QualifierPtr>;

  int below(std::size_t n) { return static_cast<int>(random_() % n); }

  Qualifier freshQualifier() {
    const std::string name = "q" + std::to_string(++names_) + "_";
    return {CIMQualifier(CIMName(name.c_str()), Uint32(1)),
            std::make_shared<ModelQualifier>(ModelQualifier{1, name})};
  }

  template <class Object>
  void decorate(Object& object, ModelElement& model) {
    for (int i = 0; i < 3; ++i) {
      const Qualifier q = freshQualifier();
      object.addQualifier(q.object);
      model.qualifiers.push_back(q.model);
    }
  }

  Class freshClass() {
    Class c{CIMClass(CIMName("A")), {}};
    for (const char* name : {"x", "y"}) {
      CIMProperty p(CIMName(name), Uint32(0));
      c.model.properties.push_back(std::make_shared<ModelElement>());
      decorate(p, *c.model.properties.back());
      c.object.addProperty(p);
    }
    CIMMethod m(CIMName("m"), CIMTYPE_UINT32);
    auto method = std::make_shared<ModelElement>();
    decorate(m, *method);
    CIMParameter a(CIMName("a"), CIMTYPE_UINT32);
    method->parts.push_back(std::make_shared<ModelElement>());
    decorate(a, *method->parts.back());
    m.addParameter(a);
    c.object.addMethod(m);
    c.model.methods.push_back(method);
    return c;
  }

  Class& anyClass() { return classes_[static_cast<std::size_t>(below(classes_.size()))]; }

  /// Calls `use` with something that has qualifiers, and its model.
  template <class Use>
  void withElement(Class& c, Use use) {
    const int which = below(4);
    if (which < 2) {
      CIMProperty p = c.object.getProperty(static_cast<Uint32>(which));
      use(p, *c.model.properties[static_cast<std::size_t>(which)]);
    } else if (which == 2) {
      CIMMethod m = c.object.getMethod(0);
      use(m, *c.model.methods[0]);
    } else {
      CIMParameter a = c.object.getMethod(0).getParameter(0);
      use(a, *c.model.methods[0]->parts[0]);
    }
  }

  void cloneClass() {
    const Class& source = anyClass();
    Class copy{source.object.clone(), source.model.clone()};
    classes_.push_back(copy);
  }

  void takeHandle() {
    withElement(anyClass(), [this](auto& object, ModelElement& model) {
      if (model.qualifiers.empty()) return;
      const int i = below(model.qualifiers.size());
      held_.push_back({object.getQualifier(static_cast<Uint32>(i)),
                       model.qualifiers[static_cast<std::size_t>(i)]});
    });
  }

  void addQualifier() {
    // Half of them are qualifiers that lie elsewhere already.
    const Qualifier q = !held_.empty() && below(2)
                            ? held_[static_cast<std::size_t>(below(held_.size()))]
                            : freshQualifier();
    withElement(anyClass(), [&](auto& object, ModelElement& model) {
      if (object.findQualifier(q.object.getName()) != PEG_NOT_FOUND) return;
      object.addQualifier(q.object);
      model.qualifiers.push_back(q.model);
    });
  }

  void removeQualifier() {
    withElement(anyClass(), [this](auto& object, ModelElement& model) {
      if (model.qualifiers.empty()) return;
      const int i = below(model.qualifiers.size());
      object.removeQualifier(static_cast<Uint32>(i));
      model.qualifiers.erase(model.qualifiers.begin() + i);
    });
  }

  void setPropertyValue() {
    Class& c = anyClass();
    const Uint32 value = ++names_;
    c.object.getProperty(1).setValue(value);
    c.model.properties[1]->value = value;
  }

  void changeThroughHandle() {
    if (held_.empty()) return;
    Qualifier& q = held_[static_cast<std::size_t>(below(held_.size()))];
    q.model->value = ++names_;
    q.object.setValue(q.model->value);
  }

  std::mt19937 random_;
  Uint32 names_ = 0;
  std::vector<Class> classes_;
  std::vector<Qualifier> held_;
};

TEST(CloneModel, EveryObjectSeesItsOwnChangesOnly) {
  for (unsigned seed = 1; seed <= 20; ++seed) {
    SCOPED_TRACE(seed);
    Walk walk(seed);
    for (int i = 0; i < 400; ++i) {
      walk.step();
      walk.check();
      if (HasFatalFailure()) return;
    }
  }
}

}  // namespace
