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
  EXPECT_EQ(toUtf8(parseNamespaceOrClass("root/host").getNameSpace().getString()), "root/host");
  EXPECT_FALSE(parseNamespaceOrClass("root/host:A").getClassName().isNull());
}

TEST(PathArgument, MalformedOnesAreReportedWithTheirColumn) {
  const struct {
    Pegasus::CIMObjectPath (*parse)(const std::string&);
    const char* text;
    int column;
    const char* reason;
  } cases[] = {
      {parseInstancePath, "root:A.a=1,b=\"x", 12,
       "object path, column 12: invalid key-value pair, missing quote in key value\n"
       "  root:A.a=1,b=\"x\n"
       "             ^"},
      {parseInstancePath, "root:A.a=\"x,y\",b", 16, "equal sign"},
      {parseInstancePath, "root:1A.a=1", 6, "class name 1A"},
      {parseInstancePath, "root:A", 7, "no keys"},
      {parseInstancePath, "A.k=\"x:y\"", 1, "no namespace"},  // the colon is the value's
      {parseClassPath, "A", 1, "no namespace"},
      {parseClassPath, "//h/root:A", 1, "host"},
      {parseClassPath, "root:A.a=1", 7, "no keys"},
      {parseClassPath, "root:", 6, "class name"},
      {parseClassPath, "root:\x1b[2J", 6, "class name \\x1b[2J"},
      {parseClassPath, "root:\xff", 6, "UTF-8"},
      {parseNamespaceOrClass, "", 1, "namespace"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.text);
    try {
      row.parse(row.text);
      ADD_FAILURE() << "accepted";
    } catch (const PathArgumentError& error) {
      EXPECT_EQ(error.column(), row.column);
      EXPECT_THAT(error.what(), HasSubstr(row.reason));
    }
  }
}

}  // namespace
