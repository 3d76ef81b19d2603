#include <Pegasus/Common/CIMObjectPath.h>
#include <gtest/gtest.h>

#include <chrono>
#include <string>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

CIMObjectPath path(const char* text) {
  return CIMObjectPath(String(text));
}

Array<CIMKeyBinding> oneKey(const char* name, const String& value, CIMKeyBinding::Type type) {
  return Array<CIMKeyBinding>(1, CIMKeyBinding(name, value, type));
}

// All parts in one line: host|namespace|class|key:type:value ...
std::string parts(const CIMObjectPath& p) {
  std::string result = text(p.getHost()) + "|" + text(p.getNameSpace().getString()) + "|" +
                       text(p.getClassName().getString()) + "|";
  const Array<CIMKeyBinding>& keys = p.getKeyBindings();
  for (Uint32 i = 0; i < keys.size(); ++i) {
    result += (i ? " " : "") + text(keys[i].getName().getString()) + ":" +
              "BSNR"[keys[i].getType()] + ":" + text(keys[i].getValue());
  }
  return result;
}

TEST(CIMObjectPath, ParsesText) {
  const struct {
    const char *text, *parts;
  } cases[] = {
      {R"(root/demo:Demo_Disk.DeviceID="x")", "|root/demo|Demo_Disk|DeviceID:S:x"},
      {"//host:5988/root/demo:Demo_Disk", "host:5988|root/demo|Demo_Disk|"},
      {"root/demo:Demo_Disk", "|root/demo|Demo_Disk|"},
      {"/root/demo:Demo_Disk", "|root/demo|Demo_Disk|"},
      {"A.b=1,a=2", "||A|a:N:2 b:N:1"},
      {R"(A.b=True,a="x")", "||A|a:S:x b:B:TRUE"},
      {"A.b=fAlSe", "||A|b:B:FALSE"},
      {"A.b=0x1F", "||A|b:N:0x1F"},
      {R"(A.b="")", "||A|b:S:"},
      {"A.", "||A|"},
      {R"(A.b="x",)", "||A|b:S:x"},
      {R"(A.b="B")", "||A|b:S:B"},
      {R"(A.b="B.")", "||A|b:S:B."},
      {R"(A.b="B.k=1")", "||A|b:R:B.k=1"},
      {R"(A.b="B.z=1,a=2")", "||A|b:R:B.a=2,z=1"},
      {R"(A.b="root/x:B.k=\"v\"")", R"(||A|b:R:root/x:B.k="v")"},
      {R"(A.k="a,b=c\"d\\e")", R"(||A|k:S:a,b=c"d\e)"},
      {"A.k=1,K=2,k=3", "||A|k:N:1 K:N:2 k:N:3"},
      {"A._z=0,b=1,A=2,a1=3,a_=4,aB=5,Z=6,a=7",
       "||A|_z:N:0 A:N:2 a:N:7 a1:N:3 a_:N:4 aB:N:5 b:N:1 Z:N:6"},
      {"//host:/root:A", "host:|root|A|"},
      {"//[::1]:5989/root:A", "[::1]:5989|root|A|"},
      {"//1.02.3.004:80/root:A", "1.02.3.004:80|root|A|"},
      {"//a-/root:A", "a-|root|A|"},
      {"//1.example.org:65535/root:A", "1.example.org:65535|root|A|"},
  };
  for (const auto& c : cases) EXPECT_EQ(parts(path(c.text)), c.parts) << c.text;
}

TEST(CIMObjectPath, RefusesMalformedText) {
  const struct {
    const char *text, *reason;
  } cases[] = {
      {"", "class name  not a legal CIM name"},
      {" A", "class name  A not a legal CIM name"},
      {"root:", "class name  not a legal CIM name"},
      {"A\xC3\xA9-.k=1", "class name A\xC3\xA9- not a legal CIM name"},
      {":A", "invalid namespace name"},
      {"a b:A", "invalid namespace name"},
      {"//host/:A", "invalid namespace name"},
      {"//host", "missing slash after hostname"},
      {"//host/A", "host specified, missing namespace"},
      {"//bad host/root:A", "invalid hostname"},
      {"//300.2.3.4/root:A", "invalid hostname"},
      {"//1.2.3.0004/root:A", "invalid hostname"},
      {"//h//root:A", "invalid namespace name"},
      {"//a..b/root:A", "invalid hostname"},
      {"//-a/root:A", "invalid hostname"},
      {"//1/root:A", "invalid hostname"},
      {"//a:65536/root:A", "invalid hostname"},
      {"//a:99999999999999999999/root:A", "invalid hostname"},
      {"//[::1/root:A", "invalid hostname"},
      {"//[::1]x/root:A", "invalid hostname"},
      {"//[::1%lo]/root:A", "invalid hostname"},
      {"//[fe80::1]/root:A", "invalid hostname"},
      {"//h\xC3\xB6st/root:A", "invalid hostname"},
      {"A.b", "invalid key-value pair, missing equal sign"},
      {"A.,", "invalid key-value pair, missing equal sign"},
      {"A.b=", "invalid key-value pair, invalid number value "},
      {"A.b=+5", "invalid key-value pair, invalid number value +5"},
      {"A.b=05", "invalid key-value pair, invalid number value 05"},
      {"A.b=99999999999999999999",
       "invalid key-value pair, invalid number value 99999999999999999999"},
      {"A.b=2.0000000000000000e+00",
       "invalid key-value pair, invalid number value 2.0000000000000000e+00"},
      {"A.b=-05", "invalid key-value pair, invalid negative number value -05"},
      {"A.b=-9223372036854775809",
       "invalid key-value pair, invalid negative number value -9223372036854775809"},
      {"A.b=tru", "invalid key-value pair, value should be TRUE or FALSE"},
      {R"(A.b="x)", "invalid key-value pair, missing quote in key value"},
      {R"(A.b="x"y)", "invalid key-value pair, next key-value pair has to start with comma"},
      {R"(A.b="x\ny")", "invalid key-value pair, malformed value"},
      {R"(A.b="x\)", "invalid key-value pair, malformed value"},
      {"A.b=1, a=2", "invalid key-value pair, invalid key name: a"},
      {"A.b =1", "invalid key-value pair, invalid key name:b "},
      {"A.1b=\"x\"", "invalid key-value pair, invalid key name:1b"},
      {"A.B.C=1", "invalid key-value pair, invalid key name:B.C"},
      {"A.b=1,,c=2", "invalid key-value pair, invalid key name:,c"},
  };
  for (const auto& c : cases) {
    const std::string message =
        std::string("malformed object name: ") + c.text + ", reason:\"" + c.reason + "\"";
    EXPECT_EQ(thrownMessage<MalformedObjectNameException>([&] { path(c.text); }), message);
  }
}

TEST(CIMObjectPath, KeepsWhatWasReadBeforeTheMistake) {
  const struct {
    const char *text, *parts;
  } cases[] = {
      {":A", "|||"},
      {"root:", "|root||"},
      {"//h/A", "h|||"},
      {"//h/root:1A", "h|root||"},
      {"A.b", "||A|"},
      {"A.z=1,a=2,c=x", "||A|z:N:1 a:N:2"},
      {R"(//h/root:A.b="x"y)", "h|root|A|b:S:x"},
      {R"(A.b="B.z=1,a=2",c)", "||A|b:R:B.z=1,a=2"},
  };
  for (const auto& c : cases) {
    CIMObjectPath assigned = path("//old/root:Old.k=1");
    EXPECT_THROW(assigned = String(c.text), MalformedObjectNameException) << c.text;
    EXPECT_EQ(parts(assigned), c.parts) << c.text;
  }
}

TEST(CIMObjectPath, ReadsUpToAUnitZero) {
  EXPECT_EQ(parts(CIMObjectPath(String("A.k=\"x\"\0,b=1", 12))), "||A|k:S:x");
  EXPECT_EQ(parts(CIMObjectPath(String("ro\0ot:A", 7))), "||ro|");
  EXPECT_THROW(CIMObjectPath(String("A.k=\"x\0y\"", 9)), MalformedObjectNameException);
}

TEST(CIMObjectPath, SortsKeysAndWritesThem) {
  Array<CIMKeyBinding> keys;
  keys.append(CIMKeyBinding("zeta", "1", CIMKeyBinding::NUMERIC));
  keys.append(CIMKeyBinding("Alpha", "x", CIMKeyBinding::STRING));
  keys.append(CIMKeyBinding("beta", "TRUE", CIMKeyBinding::BOOLEAN));
  const char* const expected = R"(root/demo:Demo_Disk.Alpha="x",beta=TRUE,zeta=1)";
  const CIMObjectPath constructed("", "root/demo", "Demo_Disk", keys);
  EXPECT_EQ(text(constructed.toString()), expected);
  CIMObjectPath assigned("", "root/demo", "Demo_Disk");
  assigned.setKeyBindings(keys);
  EXPECT_EQ(text(assigned.toString()), expected);
  EXPECT_TRUE(assigned == constructed);
}

TEST(CIMObjectPath, WritesText) {
  EXPECT_EQ(text(CIMObjectPath().toString()), "");
  EXPECT_EQ(text(CIMObjectPath("h", CIMNamespaceName(), "X").toString()), "//h/:X");
  EXPECT_EQ(text(CIMObjectPath("h:1", "root", "X").toString()), "//h:1/root:X");
  Array<CIMKeyBinding> keys = oneKey("s", "q\"b\\c", CIMKeyBinding::STRING);
  keys.append(CIMKeyBinding("n", "1\"2", CIMKeyBinding::NUMERIC));
  keys.append(CIMKeyBinding("b", "true", CIMKeyBinding::BOOLEAN));
  EXPECT_EQ(text(CIMObjectPath("", CIMNamespaceName(), "X", keys).toString()),
            R"(X.b=true,n=1\"2,s="q\"b\\c")");
}

TEST(CIMObjectPath, RewritesReferences) {
  const CIMObjectPath a("", "root/x", "A", oneKey("k", "v", CIMKeyBinding::STRING));
  const CIMObjectPath b("", "root/x", "B", oneKey("ref", a.toString(), CIMKeyBinding::REFERENCE));
  const CIMObjectPath c("h", "root/x", "C", oneKey("ref2", b.toString(), CIMKeyBinding::REFERENCE));
  const char* const expected = R"(//h/root/x:C.ref2="root/x:B.ref=\"root/x:A.k=\\\"v\\\"\"")";
  EXPECT_EQ(text(c.toString()), expected);
  EXPECT_TRUE(path(expected) == c);
  const CIMObjectPath rewritten("", "root", "D",
                                oneKey("r", "/root:A.b=true,A=1,", CIMKeyBinding::REFERENCE));
  EXPECT_EQ(text(rewritten.getKeyBindings()[0].getValue()), "root:A.A=1,b=TRUE");
}

TEST(CIMObjectPath, RefusesReferencesThatAreNoPaths) {
  for (const char* text : {"", "not a path!", "A.r=2.5", "A.n=", "A.k=\"x"}) {
    const Array<CIMKeyBinding> keys = oneKey("r", text, CIMKeyBinding::REFERENCE);
    EXPECT_THROW(CIMObjectPath("", "root", "A", keys), MalformedObjectNameException) << text;
    // The keys are left as they were given.
    CIMObjectPath changed = path("A.k=1");
    EXPECT_THROW(changed.setKeyBindings(keys), MalformedObjectNameException) << text;
    EXPECT_EQ(parts(changed), std::string("||A|r:R:") + text);
    EXPECT_THROW(changed.set("", "root", "B", keys), MalformedObjectNameException) << text;
    EXPECT_EQ(parts(changed), std::string("|root|B|r:R:") + text);
  }
}

TEST(CIMObjectPath, RefusesBadHosts) {
  const std::string message = "malformed object name: bad host, reason:\"invalid hostname\"";
  CIMObjectPath kept = path("//h/root:A");
  EXPECT_EQ(thrownMessage<MalformedObjectNameException>([&] { kept.setHost("bad host"); }),
            message);
  EXPECT_EQ(
      thrownMessage<MalformedObjectNameException>([] { CIMObjectPath("bad host", "root", "A"); }),
      message);
  EXPECT_EQ(text(kept.getHost()), "h");
  kept.setHost("");
  EXPECT_EQ(text(kept.toString()), "root:A");
}

TEST(CIMObjectPath, Compares) {
  const struct {
    const char *a, *b;
    bool equal;
  } cases[] = {
      {"A.a=1,b=2", "A.b=2,a=1", true},
      {"root:A", "ROOT:a", true},
      {"//h/root:A", "//H/root:A", true},
      {"C.r=\"A.k=1\"", "C.r=\"a.K=0x1\"", true},
      {"root:A.a=1", "A.a=1", false},
      {"//h/root:A", "root:A", false},
      {"//h:5988/root:A", "//h/root:A", false},
      {"A", "A.a=1", false},
      {"A.a=1", "A.a=1,b=2", false},
  };
  for (const auto& c : cases) {
    const CIMObjectPath a = path(c.a);
    const CIMObjectPath b = path(c.b);
    EXPECT_EQ(a == b, c.equal) << c.a << " / " << c.b;
    EXPECT_EQ(b != a, !c.equal) << c.a << " / " << c.b;
    EXPECT_EQ(a.identical(b), c.equal);
    EXPECT_TRUE(!c.equal || a.makeHashCode() == b.makeHashCode()) << c.a << " / " << c.b;
  }
  EXPECT_NE(path("A.a=\"x\"").makeHashCode(), path("A.a=\"y\"").makeHashCode());
}

TEST(CIMObjectPath, CopiesAreIndependent) {
  const CIMObjectPath original = path("//h/root:A.k=1");
  CIMObjectPath copy(original);
  copy.setClassName(CIMName("B"));
  copy.setNameSpace(CIMNamespaceName("other"));
  copy.setHost("i");
  Array<CIMKeyBinding> keys = copy.getKeyBindings();
  keys[0].setValue("2");
  keys.append(CIMKeyBinding("a", "3", CIMKeyBinding::NUMERIC));
  EXPECT_EQ(parts(copy), "i|other|B|k:N:1");
  copy.setKeyBindings(keys);
  EXPECT_EQ(parts(copy), "i|other|B|a:N:3 k:N:2");
  EXPECT_EQ(parts(original), "h|root|A|k:N:1");
}

TEST(CIMObjectPath, SurvivesHostileText) {
  const auto start = std::chrono::steady_clock::now();
  const std::string many(1 << 20, 'a');
  std::string keys = "A.";
  for (int i = 200000; i-- > 0;) keys += "k" + std::to_string(i) + "=1,";
  std::string unclosed = "A";
  for (int i = 0; i < 100000; ++i) unclosed += ".k=\"B";
  std::string backslashes = "A.k=\"" + std::string(1 << 20, '\\') + "\"";
  EXPECT_EQ(path(keys.c_str()).getKeyBindings().size(), 200000u);
  EXPECT_EQ(path(backslashes.c_str()).getKeyBindings()[0].getValue().size(), 1u << 19);
  EXPECT_EQ(path(("A.k=\"" + many + "\"").c_str()).getKeyBindings()[0].getValue().size(), 1u << 20);
  for (const std::string& hostile :
       {"//" + many + std::string("/") + std::string(1 << 20, '/'), unclosed,
        std::string(1 << 20, ':'), std::string(1 << 20, '.'), "A." + std::string(1 << 20, '='),
        "A.k=\"B.k=\\\"C.k=" + many, "A.k=" + std::string(1 << 20, '9')}) {
    EXPECT_THROW(path(hostile.c_str()), MalformedObjectNameException);
  }
  EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(60));
}

}  // namespace
