// Random changes through old and new handles, against a model that copies everything at once.
#include <Pegasus/Common/CIMClass.h>
#include <gtest/gtest.h>

#include <array>
#include <memory>
#include <random>
#include <string>
#include <vector>

using namespace Pegasus;

namespace {

/// The model of a class: the numbers of the qualifiers of its four elements, which are the
/// properties x and y, the method m and its parameter a.
using Numbers = std::vector<std::shared_ptr<Uint32>>;
using Model = std::array<Numbers, 4>;

struct Class {
  CIMClass object{CIMName("A")};
  Model model;

  Class clone() const {
    Class copy{object.clone(), model};
    for (Numbers& numbers : copy.model) {
      for (auto& number : numbers) number = std::make_shared<Uint32>(*number);
    }
    return copy;
  }
};

struct Qualifier {
  CIMQualifier object;
  std::shared_ptr<Uint32> model;
};

template <class Handle>
Uint32 numberOf(const Handle& qualifier) {
  Uint32 number = 0;
  qualifier.getValue().get(number);
  return number;
}

template <class Element>
void expectNumbers(const Element& element, const Numbers& numbers) {
  ASSERT_EQ(element.getQualifierCount(), numbers.size());
  for (Uint32 i = 0; i < numbers.size(); ++i) {
    ASSERT_EQ(numberOf(element.getQualifier(i)), *numbers[i]);
  }
}

class Walk {
 public:
  explicit Walk(unsigned seed) : random_(seed) {
    Class first;
    CIMMethod method(CIMName("m"), CIMTYPE_UINT32);
    method.addParameter(CIMParameter(CIMName("a"), CIMTYPE_UINT32));
    first.object.addProperty(CIMProperty(CIMName("x"), Uint32(0)));
    first.object.addProperty(CIMProperty(CIMName("y"), Uint32(0)));
    first.object.addMethod(method);
    classes_.push_back(first);
    for (int i = 0; i < 12; ++i) addQualifier();
  }

  void step() {
    const std::size_t kind = below(8);
    if (kind == 0 && classes_.size() < 6) classes_.push_back(anyOf(classes_).clone());
    if (kind == 1 && classes_.size() > 2) dropAny(classes_);
    if (kind == 2 || kind == 3) takeHandle();
    if (kind == 4 && !held_.empty()) dropAny(held_);
    if (kind == 5) addQualifier();
    if (kind == 6) removeQualifier();
    if (kind == 7 && !held_.empty()) {
      Qualifier& changed = anyOf(held_);
      *changed.model = ++last_;
      changed.object.setValue(last_);
    }
  }

  void check() const {
    for (const Class& each : classes_) {
      const CIMConstClass object(each.object);
      const CIMConstMethod method = object.getMethod(0);
      expectNumbers(object.getProperty(0), each.model[0]);
      expectNumbers(object.getProperty(1), each.model[1]);
      expectNumbers(method, each.model[2]);
      expectNumbers(method.getParameter(0), each.model[3]);
    }
    for (const Qualifier& each : held_) ASSERT_EQ(numberOf(each.object), *each.model);
  }

 private:
  std::size_t below(std::size_t n) { return random_() % n; }

  template <class T>
  T& anyOf(std::vector<T>& list) {
    return list[below(list.size())];
  }
  template <class T>
  void dropAny(std::vector<T>& list) {
    list.erase(list.begin() + static_cast<std::ptrdiff_t>(below(list.size())));
  }

  /// Calls `use` with any element of any class and the numbers of its qualifiers.
  template <class Use>
  void withElement(Use use) {
    Class& any = anyOf(classes_);
    const std::size_t which = below(4);
    CIMMethod method = any.object.getMethod(0);
    CIMParameter parameter = method.getParameter(0);
    CIMProperty property = any.object.getProperty(static_cast<Uint32>(which % 2));
    if (which < 2) use(property, any.model[which]);
    if (which == 2) use(method, any.model[which]);
    if (which == 3) use(parameter, any.model[which]);
  }

  void takeHandle() {
    withElement([this](auto& element, Numbers& numbers) {
      if (numbers.empty()) return;
      const std::size_t i = below(numbers.size());
      held_.push_back({element.getQualifier(static_cast<Uint32>(i)), numbers[i]});
    });
  }

  // Half of them are qualifiers that lie elsewhere already.
  void addQualifier() {
    const bool shared = !held_.empty() && below(2) == 0;
    const CIMName name(("q" + std::to_string(++last_) + "_").c_str());
    const Qualifier added =
        shared ? anyOf(held_)
               : Qualifier{CIMQualifier(name, last_), std::make_shared<Uint32>(last_)};
    withElement([&](auto& element, Numbers& numbers) {
      if (element.findQualifier(added.object.getName()) != PEG_NOT_FOUND) return;
      element.addQualifier(added.object);
      numbers.push_back(added.model);
    });
  }

  void removeQualifier() {
    withElement([this](auto& element, Numbers& numbers) {
      if (numbers.empty()) return;
      const std::size_t i = below(numbers.size());
      element.removeQualifier(static_cast<Uint32>(i));
      numbers.erase(numbers.begin() + static_cast<std::ptrdiff_t>(i));
    });
  }

  std::mt19937 random_;
  Uint32 last_ = 0;
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
      if (testing::Test::HasFatalFailure()) return;
    }
  }
}

}  // namespace
