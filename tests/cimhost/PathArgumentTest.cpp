#include "cimhost/PathArgument.h"

#include "cimhost/Text.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using testing::HasSubstr;

TEST(PathArgument, WellFormedPaths) {
  EXPECT_EQ(toUtf8(parseInstancePath("root/host:Host_FileSystem.Name=\"/\"").toString()),
            "root/host:Host_FileSystem.Name=\"/\"");
  EXPECT_EQ(parseInstancePath("root/host:Host_System.").getKeyBindings().size(), 0u);
  EXPECT_EQ(parseInstancePath("root:A.k=\"x.y:z,\\\"\"").getKeyBindings().size(), 1u);
  EXPECT_EQ(toUtf8(parseClassPath("root/host:A").getClassName().getString()), "A");
  const Pegasus::CIMObjectPath space = parseNamespaceOrClass("root/host");
  EXPECT_EQ(toUtf8(space.getNameSpace().getString()), "root/host");
  EXPECT_TRUE(space.getClassName().isNull());
  EXPECT_FALSE(parseNamespaceOrClass("root/host:A").getClassName().isNull());
}

struct MalformedCase {
  const char* name;
  Pegasus::CIMObjectPath (*parse)(const std::string&);
  const char* text;
  int column;
  const char* reason;
};

class Malformed : public testing::TestWithParam<MalformedCase> {};

TEST_P(Malformed, IsReportedWithItsColumn) {
  try {
    GetParam().parse(GetParam().text);
    FAIL() << "accepted";
  } catch (const PathArgumentError& error) {
    EXPECT_EQ(error.column(), GetParam().column);
    EXPECT_THAT(error.what(), HasSubstr(GetParam().reason));
  }
}

INSTANTIATE_TEST_SUITE_P(
    Paths, Malformed,
    testing::Values(
        MalformedCase{"OpenQuote", parseInstancePath, "root:A.a=1,b=\"x", 12, "missing quote"},
        MalformedCase{"NoValue", parseInstancePath, "root:A.a=", 8, "invalid number"},
        MalformedCase{"NoEqualSign", parseInstancePath, "root:A.a=\"x,y\",b", 16, "equal sign"},
        MalformedCase{"BadClass", parseInstancePath, "root:1A.a=1", 6, "class name 1A"},
        MalformedCase{"BadNamespace", parseClassPath, "ro ot:A", 1, "namespace"},
        MalformedCase{"NoNamespace", parseClassPath, "A", 1, "no namespace"},
        MalformedCase{"Host", parseClassPath, "//h/root:A", 1, "host"},
        MalformedCase{"KeysOnClass", parseClassPath, "root:A.a=1", 7, "no keys"},
        MalformedCase{"NoKeys", parseInstancePath, "root:A", 7, "no keys"},
        MalformedCase{"Empty", parseClassPath, "", 1, "no namespace"},
        MalformedCase{"BareNamespace", parseClassPath, "root/host", 1, "no namespace"},
        MalformedCase{"ColonInValue", parseInstancePath, "A.k=\"x:y\"", 1, "no namespace"},
        MalformedCase{"NoClass", parseClassPath, "root:", 6, "class name"},
        MalformedCase{"EmptyNamespace", parseNamespaceOrClass, "", 1, "namespace"},
        MalformedCase{"ControlCharacter", parseClassPath, "root:\x1b[2J", 6, "class name \\x1b[2J"},
        MalformedCase{"NotUtf8", parseClassPath, "root:\xff", 6, "UTF-8"}),
    [](const auto& row) { return std::string(row.param.name); });

TEST(PathArgument, TheWholeMessage) {
  try {
    parseInstancePath("root/host:A.Name=\"/");
    FAIL();
  } catch (const PathArgumentError& error) {
    EXPECT_STREQ(error.what(),
                 "object path, column 13: invalid key-value pair, missing quote in key value\n"
                 "  root/host:A.Name=\"/\n"
                 "              ^");
  }
}

}  // namespace
