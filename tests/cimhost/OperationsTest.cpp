#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::AllOf;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;
using Names = std::vector<std::string>;

class OperationsTest : public testing::Test {
 protected:
  // Into the sink, of which nothing else is left.
  std::string enumerate(const char* className, const InstanceSelection& selection = {}) {
    sink = RecordingSink();
    return textOf(operations.enumerateInstances(context, {kNamespace, className, selection}, sink));
  }
  std::string associators(const char* className, const AssociationFilter& filter) {
    sink = RecordingSink();
    return textOf(
        operations.associators(context, {kNamespace, pathOf(className), filter, {}}, sink));
  }

  TestHost host;
  const Operations& operations = host.operations;
  RecordingSink sink;
  const OperationContext context = makeContext("guest");
};

TEST_F(OperationsTest, InstancesAreThoseThatAServerWouldDeliver) {
  const struct {
    const char* className;
    const char* enumerated;
    Names names;
    const char* got = enumerated;  // how the status of getInstance starts; 0: one instance
  } cases[] = {
      {"Test_BigDisk", "0 ", {"big"}},
      {"Test_Disk", "0 ", {"a", "b", "big"}, "1 Too many objects delivered."},
      {"Test_Base", "0 ", {"a", "b", "big"}, "6 "},  // only subclasses are served
      {"Test_Unserved", "0 ", {}, "6 Test_Unserved.Name=\"a\""},
      {"Test_Array", "0 ", {"x", "y"}, "1 Too many objects delivered."},
      {"Test_Nothing", "0 ", {}, "1 The provider did not complete"},
      {"Test_OnlyCompletes", "0 ", {}, "1 Too few objects delivered."},
      {"Test_NoComplete", "0 ", {}, "1 The provider did not complete"},
      {"Test_LateDelivery", "0 ", {"a"}, ""},
      {"Test_TwoBatches", "0 ", {"b"}, ""},
      {"Test_ThrowsCim", "2 not for you", {}},
      {"Test_ThrowsSuccess", "1 odd", {}},
      {"Test_ThrowsOddCode", "1 odd", {}},
      {"Test_ThrowsNotSupported", "0 ", {}, "7 no"},
      {"Test_ThrowsPegasus", "1 The CIM name is not valid: 1x", {}},
      {"Test_ThrowsStd", "1 std \xEF\xBF\xBD", {}},
      {"Test_ThrowsInt", "1 Unknown error.", {}},
      {"Test_ServerDisks",
       "0 ",
       {"seen root/test:Test_Disk.Name=\"a\"", "seen root/test:Test_Disk.Name=\"b\"",
        "seen root/test:Test_BigDisk.Name=\"big\""},
       "1 Too many objects delivered."},
      {"Test_Uninitialized", "1 uninitialized object", {}},
      {"Test_Missing", "5 Test_Missing", {}},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.className);
    EXPECT_EQ(enumerate(row.className), row.enumerated);
    EXPECT_EQ(sink.names, row.names);
    RecordingSink single;
    const OperationStatus status =
        operations.getInstance(context, {kNamespace, pathOf(row.className), {}}, single);
    EXPECT_THAT(textOf(status), StartsWith(row.got));
    EXPECT_EQ(single.names.size(), status.ok() ? 1u : 0u);
  }
}

TEST_F(OperationsTest, WhatWasStreamedStaysButTheRestOfAFailedCallIsLost) {
  EXPECT_EQ(enumerate("Test_Many"), "0 ");
  ASSERT_EQ(sink.names.size(), 2500u);
  for (std::size_t i = 0; i < 2500; ++i) EXPECT_EQ(sink.names[i], std::to_string(i));
  EXPECT_EQ(enumerate("Test_ManyNoComplete"), "0 ");
  EXPECT_EQ(sink.names.size(), DeliveryBuffer<CIMInstance>::kLimit + 1);
  EXPECT_EQ(enumerate("Test_ManyThrows"), "1 in the middle");
  EXPECT_EQ(sink.names.size(), DeliveryBuffer<CIMInstance>::kLimit + 1);
}

// How calls end is tested with the operations; here, what happens at the limit.
TEST(DeliveryBuffer, OverTheLimitAllThatWaitsGoesOutInOrder) {
  std::vector<int> out;
  cimhost::DeliveryBuffer<int> buffer([&out](int value) { return out.push_back(value), true; }, 3);
  buffer.deliver(1);
  buffer.complete();
  buffer.endCall();
  buffer.deliver(2);
  buffer.complete();
  buffer.deliver(3);
  EXPECT_THAT(out, ElementsAre());
  buffer.deliver(4);  // 2 waits as completed, 3 and 4 as pending.
  EXPECT_THAT(out, ElementsAre(1, 2, 3, 4));
  buffer.deliver(5);
  buffer.endCall();  // without complete()
  buffer.finish();
  EXPECT_THAT(out, ElementsAre(1, 2, 3, 4));
}

class FailingSink : public InstanceSink {
 public:
  bool deliverInstance(const CIMInstance&) override {
    ++calls;
    throw std::runtime_error("client gone");
  }
  int calls = 0;
};

TEST_F(OperationsTest, ASinksExceptionReachesTheStatusAndNotTheProvider) {
  unsetenv("TEST_PROVIDER_EVENTS");
  FailingSink failing;
  EXPECT_EQ(
      operations.enumerateInstances(context, {kNamespace, "Test_Swallows", {}}, failing).message,
      "client gone");
  EXPECT_EQ(failing.calls, 1);
  EXPECT_EQ(getenv("TEST_PROVIDER_EVENTS"), nullptr);
}

TEST_F(OperationsTest, ProvidersSeeHostNamespaceAndTheClientsSpelling) {
  const CIMObjectPath path("//elsewhere/root/other:Test_EchoPath.z=0x1F,A=\"1\"");
  const GetInstanceRequest request{"ROOT/test", path, {}};
  EXPECT_TRUE(operations.getInstance(context, request, sink).ok());
  EXPECT_THAT(sink.names, ElementsAre("//" + toUtf8(operations.hostName()) +
                                      "/ROOT/test:Test_EchoPath.A=\"1\",z=0x1F"));
}

TEST_F(OperationsTest, PathsWithoutNamespaceGetTheRequests) {
  EXPECT_EQ(enumerate("Test_NoNamespace"), "0 ");
  EXPECT_EQ(toUtf8(sink.instances.at(0).getPath().toString()),
            "root/test:Test_NoNamespace.Name=\"plain\"");
  sink = RecordingSink();
  for (const char* name : {"Test_BigDisk", "Test_NoComplete"}) {
    EXPECT_TRUE(operations.enumerateInstanceNames(context, {kNamespace, name}, sink).ok());
  }
  EXPECT_THAT(sink.names, ElementsAre("root/test:Test_BigDisk.Name=\"n\"",
                                      EndsWith("/root/test:Test_BigDisk")));
}

Names propertyNames(const CIMInstance& instance) {
  Names names;
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    const CIMConstProperty property = instance.getProperty(i);
    names.push_back(toUtf8(property.getName().getString()));
    if (property.getQualifierCount() > 0) names.back() += "+qualifiers";
    if (!property.getClassOrigin().isNull()) names.back() += "+origin";
  }
  return names;
}

TEST_F(OperationsTest, SelectionIsAppliedToWhatAProviderDelivers) {
  const struct {
    const char* className;
    InstanceSelection selection;  // deep, local only, qualifiers, origin, list
    Names last;                   // of the last instance, always of Test_BigDisk
  } cases[] = {
      {"Test_Base", {true, false, true, true, {}}, {"Name+qualifiers+origin", "Size+origin"}},
      {"Test_Base", {true, false, false, true, {}}, {"Name+origin", "Size+origin"}},
      {"Test_BigDisk", {false, false, false, false, {}}, {"Name", "Size"}},
      {"Test_BigDisk", {true, true, false, false, {}}, {"Size"}},
      {"Test_Base", {true, true, false, false, {}}, {"Name", "Size"}},  // local to a superclass
      {"Test_Disk", {false, true, false, false, {}}, {}},
      {"Test_Base", {true, false, false, false, listOf({"SIZE", "Nope"})}, {"Size"}},
      {"Test_Base", {false, false, false, false, listOf({"Size"})}, {}},
      {"Test_Base", {true, false, false, false, listOf({})}, {}},
  };
  for (const auto& row : cases) {
    EXPECT_EQ(enumerate(row.className, row.selection), "0 ");
    ASSERT_FALSE(sink.instances.empty());
    EXPECT_EQ(propertyNames(sink.instances.back()), row.last) << &row - cases;
  }
}

TEST_F(OperationsTest, WhatIsNotThere) {
  TestHost bare("Bare");
  const CIMNamespaceName nowhere("root/nowhere");
  const CIMName disk("Test_Disk");
  const CIMName missing("Test_Missing");
  const CIMObjectPath path = pathOf("Test_Disk");
  EXPECT_EQ(bare.operations.getInstance(context, {kNamespace, path, {}}, sink).code, 7);
  EXPECT_EQ(bare.operations.invokeMethod(context, {kNamespace, path, "Any", {}}, sink).code, 7);
  EXPECT_EQ(operations.enumerateInstances(context, {nowhere, disk, {}}, sink).code, 3);
  EXPECT_EQ(operations.enumerateInstances(context, {kNamespace, CIMName(), {}}, sink).code, 5);
  EXPECT_EQ(operations.enumerateClassNames({kNamespace, missing, true}, sink).code, 5);
  EXPECT_EQ(operations.enumerateClasses({nowhere, disk}, sink).message, "root/nowhere");
  EXPECT_EQ(operations.invokeMethod(context, {nowhere, path, "Any", {}}, sink).code, 3);
  EXPECT_EQ(bare.operations.associatorNames(context, {kNamespace, path, {}}, sink).code, 0);
  EXPECT_EQ(operations.associatorNames(context, {nowhere, path, {}}, sink).code, 3);
  EXPECT_EQ(operations.associatorNames(context, {kNamespace, pathOf("Nope"), {}}, sink).code, 4);
  EXPECT_EQ(
      operations.associatorNames(context, {kNamespace, CIMObjectPath("Test_Disk"), {}}, sink).code,
      7);
}

TEST_F(OperationsTest, EndlessRecursionFailsAndTheHostGoesOn) {
  setenv("TEST_PROVIDER_EVENTS", "", 1);
  for (int round = 0; round < 2; ++round) {
    EXPECT_THAT(enumerate("Test_Nested"), AllOf(StartsWith("1 "), HasSubstr("inside each other")));
  }
  const std::string events = getenv("TEST_PROVIDER_EVENTS");
  EXPECT_EQ(std::count(events.begin(), events.end(), ';'), 2 * (EmbeddedCimom::kMaximumDepth + 1));
}

TEST_F(OperationsTest, ErrorsOfTheProvidersHandleAreThoseOfAServer) {
  CIMOMHandle handle;
  const auto instance = [&](const char* name) {
    return textOf(runOperation(
        [&] { handle.getInstance(context, kNamespace, pathOf(name), false, true, true, {}); }));
  };
  EXPECT_EQ(textOf(runOperation([&] {
              handle.getClass(context, "root/nowhere", "Test_Disk", false, true, true, {});
            })),
            "3 root/nowhere");
  EXPECT_EQ(instance("Nope"), "5 Nope");
  EXPECT_EQ(instance("Test_Unserved"), "6 Test_Unserved.Name=\"a\"");
  EXPECT_EQ(instance("Test_BigDisk"), "0 ");
}

CIMInstance instanceOf(const char* className) {
  CIMInstance instance((CIMName(className)));
  instance.setPath(pathOf(className));
  return instance;
}

TEST_F(OperationsTest, ChangesEndAsOnAServer) {
  constexpr const char* kUnserved = "7 No provider serves class Test_Unserved";
  const struct {
    const char* className;
    const char* modified;
    const char* created = modified;
    const char* deleted = modified;
  } cases[] = {
      {"Test_Disk", "0 "},
      {"Test_Nothing", "0 "},
      {"Test_OnlyCompletes", "0 ", "1 Too few objects delivered.", "0 "},
      {"Test_ThrowsCim", "2 not for you"},
      {"Test_ThrowsNotSupported", "7 no"},  // not swallowed here
      {"Test_Unserved", kUnserved},
      {"Test_Missing", "5 Test_Missing"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.className);
    sink.names.clear();
    const CIMInstance instance = instanceOf(row.className);
    EXPECT_EQ(textOf(operations.modifyInstance(context, {kNamespace, instance, true, {}})),
              row.modified);
    EXPECT_EQ(textOf(operations.createInstance(context, {kNamespace, instance}, sink)),
              row.created);
    EXPECT_EQ(textOf(operations.deleteInstance(context, {kNamespace, pathOf(row.className)})),
              row.deleted);
    if (row.created == std::string("0 ")) {
      EXPECT_THAT(sink.names,
                  ElementsAre("root/test:" + std::string(row.className) + ".Name=\"new\""));
    }
  }
}

// As it was sent, but for the properties that the client does not want to change.
TEST_F(OperationsTest, TheProviderGetsTheInstanceAsSent) {
  CIMInstance instance = instanceOf("test_ECHOPATH");
  instance.addProperty(CIMProperty("Undeclared", CIMValue(Uint8(1))));
  instance.addProperty(CIMProperty("Size", CIMValue(String("not a number"))));
  const struct {
    CIMPropertyList list;
    const char* received;
  } cases[] = {{{}, "2 NULL"}, {listOf({"SIZE", "Other"}), "1 SIZE, Other"}};
  for (const auto& row : cases) {
    setenv("TEST_PROVIDER_EVENTS", "", 1);
    EXPECT_TRUE(operations.modifyInstance(context, {kNamespace, instance, false, row.list}).ok());
    EXPECT_THAT(getenv("TEST_PROVIDER_EVENTS"),
                testing::MatchesRegex("//[^/]+/root/test:test_ECHOPATH\\.Name=\"a\" "
                                      "test_ECHOPATH\\.Name=\"a\" " +
                                      std::string(row.received) + ";"));
  }
  EXPECT_EQ(instance.getPropertyCount(), 2u);
  EXPECT_EQ(operations.modifyInstance(context, {kNamespace, CIMInstance(), true, {}}).code,
            CIM_ERR_FAILED);
}

TEST_F(OperationsTest, MethodsEndAsOnAServer) {
  Array<CIMParamValue> parameters;
  parameters.append(CIMParamValue("uNdeclared", CIMValue(Uint8(5))));
  const struct {
    const char *path, *method, *status;
    const char* returnValue = "not delivered";
  } cases[] = {
      {"Test_Disk.Name=\"a\"", "Any", "0 ", "7"},
      {"Test_Disk", "Any", "0 ", "7"},  // a class path
      {"Test_Disk", "Nothing", "0 ", "null"},
      {"Test_Disk", "NoComplete", "0 ", "null"},
      {"Test_Disk", "Twice", "0 ", "2"},
      {"Test_Disk", "ThrowsCim", "2 not for you"},
      {"Test_Disk", "ThrowsNotSupported", "7 no"},
      {"Test_BigDisk", "Format", "16 Format"},  // served, but not its methods
      {"Test_Unserved", "Nope", "17 Nope"},
      {"Test_Missing", "Format", "6 Test_Missing"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(std::string(row.path) + " " + row.method);
    sink = RecordingSink();
    const InvokeMethodRequest request{kNamespace, CIMObjectPath(row.path), row.method, parameters};
    EXPECT_EQ(textOf(operations.invokeMethod(context, request, sink)), row.status);
    EXPECT_EQ(sink.returnValue, row.returnValue);
    if (row.returnValue != std::string("7")) continue;
    EXPECT_THAT(sink.names, ElementsAre("uNdeclared=5", StartsWith("Target=//")));
  }
}

AssociationFilter filterOf(const char* association, const char* result = "", const char* role = "",
                           const char* resultRole = "") {
  const auto name = [](const char* text) { return *text == '\0' ? CIMName() : CIMName(text); };
  return {name(association), name(result), String(role), String(resultRole)};
}

// associators and associatorNames must agree.
TEST_F(OperationsTest, AssociationFiltersFollowTheDeclarations) {
  const Names fast = {"Link_FastPort 1", "Link_FastPort 2"};
  const Names port = {"Link_Port 1", "Link_Port 2", "Link_FastPort 1", "Link_FastPort 2"};
  const Names copy = {"Link_Copy 1", "Link_Copy 2"};
  Names all = port;
  all.insert(all.end(), copy.begin(), copy.end());
  const Names fastOnly = {"Link_Port 2", "Link_FastPort 2", "Link_Copy 2"};
  const struct {
    const char* objectClass;
    AssociationFilter filter;
    Names results;
  } cases[] = {
      {"test_bigdisk", filterOf(""), all},  // references for a superclass count
      {"Test_Base", filterOf(""), copy},    // those for a subclass do not
      {"Test_Array", filterOf(""), {}},
      {"Test_Disk", filterOf("link_PORT"), port},
      {"Test_Disk", filterOf("Link_FastPort"), fast},
      {"Test_Disk", filterOf("Link_Unserved"), {}},
      {"Test_Disk", filterOf("Test_Disk"), {}},  // no association
      {"Test_Disk", filterOf("", "test_fastport"), fastOnly},
      {"Test_Disk", filterOf("", "", "disk"), port},
      {"Test_Disk", filterOf("", "", "Port"), {}},  // the other end
      {"Test_Disk", filterOf("", "", "1 \xC3\xA9"), {}},
      {"Test_Disk", filterOf("", "", "", "PORT"), port},
      {"Test_Disk", filterOf("", "", "", "Disk"), {}},  // this end
      {"Test_Disk", filterOf("", "", "", "Copy"), {}},  // the role is for another class
      {"Test_Disk", filterOf("Link_Half"), {}},         // it has no other end
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(&row - cases);
    EXPECT_EQ(associators(row.objectClass, row.filter), "0 ");
    EXPECT_EQ(sink.names, row.results);
    RecordingSink paths;
    operations.associatorNames(context, {kNamespace, pathOf(row.objectClass), row.filter}, paths);
    Names keys;
    for (const std::string& path : paths.names) {
      keys.push_back(path.substr(path.find('"') + 1, path.rfind('"') - path.find('"') - 1));
    }
    EXPECT_EQ(keys, row.results);
  }
}

TEST_F(OperationsTest, AssociationsEndAsOnAServer) {
  const struct {
    AssociationFilter filter;
    const char* status;
    Names results;
  } cases[] = {
      {filterOf("Link_NoComplete"), "0 ", {}},
      {filterOf("Link_ThrowsNotSupported"), "0 ", {}},
      {filterOf("Link_ThrowsCim"), "2 not for you", {}},
      {filterOf("Link_Class"), "1 dynamic cast failed", {}},
      {filterOf(""), "2 not for you", {}},  // the first that fails takes the others back
      {filterOf("Link_Missing"), "4 Link_Missing", {}},
      // The client's words reach the provider, with the class that is served.
      {filterOf("link_ECHO", "", "ODD", "port"), "0 ", {"TEST_odd|Link_Echo||ODD|port"}},
      {filterOf("LINK_echo", "test_port"), "0 ", {"TEST_odd|Link_Echo|test_port||"}},
  };
  for (const auto& row : cases) {
    EXPECT_EQ(associators("TEST_odd", row.filter), row.status);
    EXPECT_EQ(sink.names, row.results) << row.status;
  }
}

TEST_F(OperationsTest, EachAssociationClassIsAskedForItsOwnReferences) {
  RecordingSink paths;
  const auto follow = [&](const char* className, const AssociationFilter& filter) {
    const CIMObjectPath path = pathOf(className);
    EXPECT_TRUE(operations.references(context, {kNamespace, path, filter, {}}, sink).ok());
    EXPECT_TRUE(operations.referenceNames(context, {kNamespace, path, filter}, paths).ok());
  };
  follow("Test_Odd", filterOf("Link_ThrowsNotSupported"));
  follow("Test_Disk", filterOf("Link_Port", "", "disk"));
  EXPECT_THAT(sink.names,
              ElementsAre("Test_Disk|Link_Port||disk|", "Test_Disk|Link_FastPort||disk|"));
  EXPECT_THAT(paths.names, ElementsAre(EndsWith("Link_Port.Name=\"link\""),
                                       EndsWith("Link_FastPort.Name=\"link\"")));
}

}  // namespace
