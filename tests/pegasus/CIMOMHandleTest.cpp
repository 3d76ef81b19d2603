#include <Pegasus/Provider/CIMOMHandle.h>
#include <gtest/gtest.h>

#include "tests/provider/TestHost.h"

using namespace Pegasus;

namespace {

template <class Action>
CIMStatusCode statusOf(Action action) {
  try {
    action();
  } catch (const CIMException& exception) {
    return exception.getCode();
  }
  return CIM_ERR_SUCCESS;
}

TEST(CIMOMHandle, ReachesTheHostOfItsConstruction) {
  const OperationContext none;
  const CIMNamespaceName root("root/x");
  const CIMName a("A");
  CIMOMHandle before;
  TestHost host;
  host.add(CIMClass(a));
  setEmbeddedHost(&host);
  CIMOMHandle handle;
  setEmbeddedHost(nullptr);
  CIMOMHandle copy(handle);
  const auto getClass = [&](CIMOMHandle& from) {
    from.getClass(none, root, a, true, true, true, {});
  };
  const CIMObjectPath path(String("A.k=1"));
  const auto erase = [&] { copy.deleteInstance(none, root, path); };
  EXPECT_EQ(statusOf([&] { getClass(copy); }), CIM_ERR_SUCCESS);
  EXPECT_EQ(statusOf([&] { getClass(before); }), CIM_ERR_FAILED);
  EXPECT_EQ(statusOf(erase), CIM_ERR_NOT_SUPPORTED) << "what the host does not offer";
}

}  // namespace
