// One class object, cloned and read by several threads at once. For the thread sanitizer, too.
#include <Pegasus/Common/CIMClass.h>
#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

using namespace Pegasus;

namespace {

CIMClass makeClass() {
  CIMClass cls(CIMName("A"));
  for (const char* name : {"p0", "p1"}) {
    CIMProperty p(CIMName(name), String("initial"));
    p.addQualifier(CIMQualifier(CIMName("Text"), String("text")));
    cls.addProperty(p);
  }
  CIMMethod method(CIMName("m"), CIMTYPE_UINT32);
  CIMParameter parameter(CIMName("a"), CIMTYPE_UINT32);
  parameter.addQualifier(CIMQualifier(CIMName("In"), Boolean(true)));
  method.addParameter(parameter);
  cls.addMethod(method);
  return cls;
}

/// Changes every kind of element of a clone; true when the result is as expected.
bool changeClone(CIMClass cls, Uint32 number) {
  for (Uint32 i = 0; i < cls.getPropertyCount(); ++i) {
    cls.getProperty(i).setValue(String("changed"));
    cls.getProperty(i).getQualifier(0).setValue(number);
  }
  CIMQualifier in = cls.getMethod(0).getParameter(0).getQualifier(0);
  in.setValue(number);
  const CIMClass next = cls.clone();
  in.setValue(Boolean(false));
  const CIMConstMethod method = CIMConstClass(next).getMethod(0);
  return method.getParameter(0).getQualifier(0).getValue() == CIMValue(number) &&
         CIMConstClass(next).getProperty(1).getQualifier(0).getValue() == CIMValue(number);
}

TEST(CloneThreads, ClonesAreIndependentFromTheFirst) {
  for (int round = 0; round < 40; ++round) {
    // Fresh, so that the threads race for the very first clone.
    const CIMClass shared = makeClass();
    std::atomic<int> good{0};
    std::vector<std::thread> threads;
    for (Uint32 t = 0; t < 3; ++t) {
      threads.emplace_back([&, t] {
        for (Uint32 i = 0; i < 10; ++i) {
          good += changeClone(shared.clone(), t * 100 + i);
          const CIMConstQualifier q = shared.getProperty(1).getQualifier(0);
          good += q.getValue() == CIMValue(String("text"));
        }
      });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(good, 60);
    EXPECT_TRUE(shared.identical(makeClass()));
  }
}

}  // namespace
