#include <Pegasus/Common/CIMObjectPath.h>

#include <chrono>
#include <tuple>
#include <utility>

#include "PegasusText.h"

using namespace Pegasus;

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
  const std::pair<const char*, const char*> cases[] = {
      {"//host:5988/root/demo:Demo_Disk", "host:5988|root/demo|Demo_Disk|"},
      {"/root/demo:Demo_Disk", "|root/demo|Demo_Disk|"},
      {R"(A.b=True,a="x")", "||A|a:S:x b:B:TRUE"},
      {"A.b=fAlSe", "||A|b:B:FALSE"},
      {"A.b=0x1F", "||A|b:N:0x1F"},
      {R"(A.b="")", "||A|b:S:"},
      {"A.", "||A|"},
      {R"(A.b="x",)", "||A|b:S:x"},
      {R"(A.b="B.")", "||A|b:S:B."},
      {R"(A.b="B.z=1,a=2")", "||A|b:R:B.a=2,z=1"},
      {R"(A.b="root/x:B.k=\"v\"")", R"(||A|b:R:root/x:B.k="v")"},
      {R"(A.k="a,b=c\"d\\e")", R"(||A|k:S:a,b=c"d\e)"},
      {"A._z=0,b=1,A=2,a1=3,a_=4,aB=5,Z=6,a=7",
       "||A|_z:N:0 A:N:2 a:N:7 a1:N:3 a_:N:4 aB:N:5 b:N:1 Z:N:6"},
      {"//host:/root:A", "host:|root|A|"},
      {"//[::1]:5989/root:A", "[::1]:5989|root|A|"},
      {"//1.02.3.004:80/root:A", "1.02.3.004:80|root|A|"},
      {"//a-/root:A", "a-|root|A|"},
      {"//1.example.org:65535/root:A", "1.example.org:65535|root|A|"},
  };
  for (const auto& [given, expected] : cases) EXPECT_EQ(parts(path(given)), expected) << given;
  // Up to a unit 0.
  EXPECT_EQ(parts(CIMObjectPath(String("A.k=\"x\"\0,b=1", 12))), "||A|k:S:x");
  EXPECT_THROW(CIMObjectPath(String("A.k=\"x\0y\"", 9)), MalformedObjectNameException);
}

TEST(CIMObjectPath, RefusesMalformedText) {
  const std::string pair = "invalid key-value pair, ";
  const std::pair<const char*, std::string> cases[] = {
      {"", "class name  not a legal CIM name"},
      {"A\xC3\xA9-.k=1", "class name A\xC3\xA9- not a legal CIM name"},
      {":A", "invalid namespace name"},
      {"a b:A", "invalid namespace name"},
      {"//host/:A", "invalid namespace name"},
      {"//h//root:A", "invalid namespace name"},
      {"//host", "missing slash after hostname"},
      {"//host/A", "host specified, missing namespace"},
      {"//bad host/root:A", "invalid hostname"},
      {"//300.2.3.4/root:A", "invalid hostname"},
      {"//1.2.3.0004/root:A", "invalid hostname"},
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
      {"A.b", pair + "missing equal sign"},
      {"A.b=", pair + "invalid number value "},
      {"A.b=+5", pair + "invalid number value +5"},
      {"A.b=05", pair + "invalid number value 05"},
      {"A.b=99999999999999999999", pair + "invalid number value 99999999999999999999"},
      {"A.b=2.0e+00", pair + "invalid number value 2.0e+00"},
      {"A.b=-05", pair + "invalid negative number value -05"},
      {"A.b=-9223372036854775809", pair + "invalid negative number value -9223372036854775809"},
      {"A.b=tru", pair + "value should be TRUE or FALSE"},
      {R"(A.b="x)", pair + "missing quote in key value"},
      {R"(A.b="x"y)", pair + "next key-value pair has to start with comma"},
      {R"(A.b="x\ny")", pair + "malformed value"},
      {R"(A.b="x\)", pair + "malformed value"},
      {"A.b=1, a=2", pair + "invalid key name: a"},
      {"A.1b=\"x\"", pair + "invalid key name:1b"},
      {"A.b=1,,c=2", pair + "invalid key name:,c"},
  };
  for (const auto& [given, reason] : cases) {
    EXPECT_EQ(thrownMessage<MalformedObjectNameException>([given = given] { path(given); }),
              std::string("malformed object name: ") + given + ", reason:\"" + reason + "\"");
  }
}

TEST(CIMObjectPath, KeepsWhatWasReadBeforeTheMistake) {
  const std::pair<const char*, const char*> cases[] = {
      {":A", "|||"},
      {"root:", "|root||"},
      {"//h/A", "h|||"},
      {"//h/root:1A", "h|root||"},
      {"A.z=1,a=2,c=x", "||A|z:N:1 a:N:2"},
      {R"(A.b="B.z=1,a=2",c)", "||A|b:R:B.z=1,a=2"},
  };
  for (const auto& [given, expected] : cases) {
    CIMObjectPath assigned = path("//old/root:Old.k=1");
    EXPECT_THROW(assigned = String(given), MalformedObjectNameException) << given;
    EXPECT_EQ(parts(assigned), expected) << given;
  }
}

TEST(CIMObjectPath, SortsKeysAndWritesText) {
  EXPECT_EQ(text(CIMObjectPath().toString()), "");
  EXPECT_EQ(text(CIMObjectPath("h:1", CIMNamespaceName(), "X").toString()), "//h:1/:X");
  Array<CIMKeyBinding> keys = oneKey("s", "q\"b\\c", CIMKeyBinding::STRING);
  keys.append(CIMKeyBinding("n", "1\"2", CIMKeyBinding::NUMERIC));
  keys.append(CIMKeyBinding("B", "true", CIMKeyBinding::BOOLEAN));
  CIMObjectPath assigned("", "root", "X");
  assigned.setKeyBindings(keys);
  EXPECT_EQ(text(assigned.toString()), R"(root:X.B=true,n=1\"2,s="q\"b\\c")");
  EXPECT_TRUE(assigned == CIMObjectPath("", "root", "X", keys));
}

TEST(CIMObjectPath, RewritesReferences) {
  const CIMObjectPath a("", "root/x", "A", oneKey("k", "v", CIMKeyBinding::STRING));
  const CIMObjectPath b("", "root/x", "B", oneKey("ref", a.toString(), CIMKeyBinding::REFERENCE));
  const CIMObjectPath c("h", "root/x", "C", oneKey("ref2", b.toString(), CIMKeyBinding::REFERENCE));
  const char* const expected = R"(//h/root/x:C.ref2="root/x:B.ref=\"root/x:A.k=\\\"v\\\"\"")";
  EXPECT_EQ(text(c.toString()), expected);
  EXPECT_TRUE(path(expected) == c);
  const auto keys = oneKey("r", "/root:A.b=true,A=1,", CIMKeyBinding::REFERENCE);
  EXPECT_EQ(parts(CIMObjectPath("", "root", "D", keys)), "|root|D|r:R:root:A.A=1,b=TRUE");
}

TEST(CIMObjectPath, RefusesReferencesThatAreNoPaths) {
  for (const char* text : {"", "not a path!", "A.n=", "A.k=\"x"}) {
    const Array<CIMKeyBinding> keys = oneKey("r", text, CIMKeyBinding::REFERENCE);
    CIMObjectPath changed = path("A.k=1");
    EXPECT_THROW(changed.setKeyBindings(keys), MalformedObjectNameException) << text;
    EXPECT_EQ(parts(changed), std::string("||A|r:R:") + text) << "kept as given";
    EXPECT_THROW(changed.set("", "root", "B", keys), MalformedObjectNameException) << text;
  }
}

TEST(CIMObjectPath, RefusesBadHosts) {
  const std::string message = "malformed object name: bad host, reason:\"invalid hostname\"";
  CIMObjectPath kept = path("//h/root:A");
  EXPECT_EQ(thrownMessage<Exception>([&] { kept.setHost("bad host"); }), message);
  EXPECT_EQ(thrownMessage<Exception>([] { CIMObjectPath("bad host", "root", "A"); }), message);
  EXPECT_EQ(text(kept.getHost()), "h");
  kept.setHost("");
  EXPECT_EQ(text(kept.toString()), "root:A");
}

TEST(CIMObjectPath, Compares) {
  const std::tuple<const char*, const char*, bool> cases[] = {
      {"A.a=1,b=2", "A.b=2,a=1", true},
      {"//h/root:AZ", "//H/ROOT:az", true},
      {"C.r=\"A.k=1\"", "C.r=\"a.K=0x1\"", true},
      {"root:A.a=1", "A.a=1", false},
      {"//h:5988/root:A", "//h/root:A", false},
      {"A.a=1", "A.a=1,b=2", false},
      {"A.a=1", "A.a=2", false},
      {"A", "B", false},
  };
  for (const auto& [left, right, equal] : cases) {
    const CIMObjectPath a = path(left), b = path(right);
    EXPECT_EQ(a == b, equal) << left << " / " << right;
    EXPECT_EQ(b != a, !equal);
    EXPECT_EQ(a.identical(b), equal);
    EXPECT_TRUE(!equal || a.makeHashCode() == b.makeHashCode()) << left << " / " << right;
  }
  EXPECT_NE(path("A.a=\"x\"").makeHashCode(), path("A.a=\"y\"").makeHashCode());
}

TEST(CIMObjectPath, CopiesAreIndependent) {
  const CIMObjectPath original = path("//h/root:A.k=1");
  CIMObjectPath copy(original);
  copy.setClassName(CIMName("B"));
  copy.setNameSpace(CIMNamespaceName("other"));
  copy.setHost("i");
  copy.setKeyBindings(oneKey("k", "2", CIMKeyBinding::NUMERIC));
  EXPECT_EQ(parts(copy), "i|other|B|k:N:2");
  EXPECT_EQ(parts(original), "h|root|A|k:N:1");
}

TEST(CIMObjectPath, SurvivesHostileText) {
  const auto start = std::chrono::steady_clock::now();
  const auto many = [](char one) { return std::string(1 << 20, one); };
  const auto firstKey = [](const std::string& given) {
    return path(given.c_str()).getKeyBindings()[0].getValue();
  };
  std::string keys = "A.", unclosed = "A";
  for (int i = 200000; i-- > 0;) keys += "k" + std::to_string(i) + "=1,";
  for (int i = 0; i < 100000; ++i) unclosed += ".k=\"B";
  EXPECT_EQ(path(keys.c_str()).getKeyBindings().size(), 200000u);
  EXPECT_EQ(firstKey("A.k=\"" + many('\\') + "\"").size(), 1u << 19);
  EXPECT_EQ(firstKey("A.k=\"" + many('a') + "\"").size(), 1u << 20);
  for (const std::string& hostile :
       {"//" + many('a') + "/" + many('/'), unclosed, many(':'), many('.'), "A." + many('='),
        "A.k=\"B.k=\\\"C.k=" + many('a'), "A.k=" + many('9')}) {
    EXPECT_THROW(path(hostile.c_str()), MalformedObjectNameException);
  }
  EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(60));
}

}  // namespace
