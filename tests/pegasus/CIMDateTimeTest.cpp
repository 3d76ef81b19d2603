#include <Pegasus/Common/CIMDateTime.h>
#include <gtest/gtest.h>

#include <ctime>
#include <string>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

constexpr const char* kZero = "00000000000000.000000:000";

TEST(CIMDateTime, KeepsWellFormedText) {
  const struct {
    const char* text;
    bool interval;
  } cases[] = {
      {"20260101120000.000000+060", false}, {"20260101120000.000000-060", false},
      {"20260101120000.123456+999", false}, {"99991231235959.999999+000", false},
      {"00000101120000.000000+000", false}, {"20240229120000.000000+000", false},
      {"19000228235959.000001-001", false}, {"20000229000000.000000+000", false},
      {"20261231000000.000000+000", false}, {"20260131000000.000000+000", false},
      {"12345678231559.123456:000", true},  {"99999999235959.999999:000", true},
      {"20260101120000.******+060", false}, {"20260101120000.12****+060", false},
      {"20260101120000.12345*+060", false}, {"202601011200**.******+060", false},
      {"2026010112****.******+060", false}, {"20260101******.******+060", false},
      {"202602********.******+060", false}, {"2026**********.******+060", false},
      {"**************.******+000", false}, {"00000001******.******:000", true},
      {"**************.******:000", true},  {kZero, true},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.text);
    const CIMDateTime value{String(c.text)};
    EXPECT_EQ(text(value.toString()), c.text);
    EXPECT_EQ(value.isInterval(), c.interval);
    EXPECT_TRUE(value == value);
    EXPECT_FALSE(value < value);
  }
  EXPECT_EQ(text(CIMDateTime().toString()), kZero);
  EXPECT_EQ(text(CIMDateTime("20260101120000.000000-000").toString()), "20260101120000.000000+000");
}

TEST(CIMDateTime, RefusesDigitsOutOfRange) {
  const struct {
    const char* text;
    const char* reason;
  } cases[] = {
      {"20260229120000.000000+000", "illegal day number"},
      {"19000229120000.000000+000", "illegal day number"},
      {"20260100120000.000000+000", "illegal day number"},
      {"20261301120000.000000+000", "illegal month number"},
      {"20260001120000.000000+000", "illegal month number"},
      {"20260101240000.000000+000", "illegal hours number "},
      {"20260101126000.000000+000", "illegal minutes number "},
      {"20260101120060.000000+000", "illegal seconds number "},
      {"00000001240000.000000:000", "illegal hours number "},
  };
  for (const auto& c : cases) {
    EXPECT_EQ(thrownMessage<DateTimeOutOfRangeException>([&] { CIMDateTime x{String(c.text)}; }),
              std::string("DateTime is out of range : ") + c.reason)
        << c.text;
  }
}

TEST(CIMDateTime, RefusesMalformedText) {
  for (const char* malformed :
       {"", "2026-01-01", "20260101120000.000000+0600", "20260101120000,000000+060",
        "20260101120000.000000*060", "00000001000000.000000:001", "20260101120000.12*4**+060",
        "2026010112****.000000+060", "20260101120000.000000+***", "20260101120***.******+060",
        "202601*********.*****+060", "00000*********.******:000", "2*************.******+000",
        "20260101120000.000000+-60", "20260101120000.00000 +060",
        "2026010112000\xC3\xA9.000000+060"}) {
    CIMDateTime value("20260101120000.000000+060");
    EXPECT_EQ(thrownMessage<InvalidDateTimeFormatException>([&] { value.set(malformed); }),
              "invalid datetime format")
        << malformed;
    EXPECT_EQ(text(value.toString()), kZero);
  }
  EXPECT_THROW(CIMDateTime(String("2026010112\0"
                                  "000.000000+060",
                                  25)),
               InvalidDateTimeFormatException);
  EXPECT_THROW(CIMDateTime(String(std::string(1 << 20, '0').c_str())),
               InvalidDateTimeFormatException);
}

TEST(CIMDateTime, ComparesInstants) {
  const struct {
    const char *a, *b;
    int order;
  } cases[] = {
      {"20260101120000.000000+060", "20260101110000.000000+000", 0},
      {"20260101000000.000000+060", "20251231230000.000000+000", 0},
      {"20260101120000.000000+060", "20260101120000.000000+000", -1},
      {"20260101120000.000001+000", "20260101120000.000000+000", 1},
      {"20240301000000.000000+000", "20240229235959.999999+000", 1},
      {"20260101120000.******+000", "20260101120000.999999+000", 0},
      {"202602********.******+000", "20260228235959.999999+000", 0},
      {"2024**********.******+000", "20241231235959.999999+000", 0},
      {"2026**********.******+000", "20251231235959.999999+000", 1},
      {"**************.******+000", "99991231235959.999999-999", 0},
      // The offset counts for what is given: all of it, its hours, nothing.
      {"202601011200**.******+090", "20260101103000.000000+000", 0},
      {"2026010112****.******+090", "20260101110000.000000+000", 0},
      {"2026010112****.******-090", "20260101125959.999999+000", 1},
      {"20260101******.******+060", "20260101000000.000000+000", 0},
      {"20260101******.******+060", "20251231235959.999999+000", 1},
      // Before the year 0 in UTC the count goes round.
      {"00000101000000.000000+001", "99991231235959.999999+000", 1},
      {"00000000000000.000001:000", kZero, 1},
      {"**************.******:000", "99999999235959.999999:000", 0},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(std::string(c.a) + " / " + c.b);
    const CIMDateTime a{String(c.a)};
    const CIMDateTime b{String(c.b)};
    EXPECT_EQ(a == b, c.order == 0);
    EXPECT_EQ(a != b, c.order != 0);
    EXPECT_EQ(a < b, c.order < 0);
    EXPECT_EQ(b > a, c.order < 0);
    EXPECT_EQ(a <= b, c.order <= 0);
    EXPECT_EQ(b<a, c.order> 0);
  }
}

TEST(CIMDateTime, RefusesToCompareDifferentKinds) {
  const CIMDateTime stamp("20260101120000.000000+060");
  const std::string message =
      "type mismatch: Trying to compare CIMDateTime objects of differing types";
  EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { (void)(stamp == CIMDateTime()); }), message);
  EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { (void)(stamp < CIMDateTime()); }), message);
  EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { stamp.equal(CIMDateTime()); }), message);
  EXPECT_THROW(CIMDateTime::getDifference(stamp, CIMDateTime()), InvalidDateTimeFormatException);
}

TEST(CIMDateTime, CountsMicroSeconds) {
  const CIMDateTime day("00000001000000.000000:000");
  EXPECT_EQ(day.toMicroSeconds(), 86400000000ULL);
  EXPECT_EQ(text(CIMDateTime(90061000001ULL, true).toString()), "00000001010101.000001:000");
  // From the year 0 to 1970: 719528 days.
  const CIMDateTime epoch("19700101000000.000000+000");
  EXPECT_EQ(epoch.toMicroSeconds(), 719528ULL * 86400000000ULL);
  EXPECT_TRUE(CIMDateTime(epoch.toMicroSeconds(), false) == epoch);
  EXPECT_EQ(CIMDateTime::getDifference(epoch, CIMDateTime("19700101000000.000000+001")), -60000000);
  EXPECT_EQ(CIMDateTime("00000101000000.000000+001").toMicroSeconds(), Uint64(-60000000));
  EXPECT_EQ(CIMDateTime("20260101******.******+060").toMicroSeconds(), 63934444800000000ULL);
  EXPECT_EQ(CIMDateTime("**************.******:000").toMicroSeconds(), 86400000000ULL);
  const std::string outOfRange = "DateTime is out of range : Cannot create a CIMDateTime ";
  EXPECT_EQ(thrownMessage<DateTimeOutOfRangeException>([] { CIMDateTime(~0ULL, true); }),
            outOfRange + "interval greater than 100 million days");
  EXPECT_EQ(thrownMessage<DateTimeOutOfRangeException>([] { CIMDateTime(~0ULL, false); }),
            outOfRange + "time stamp beyond the year 10,000");
}

TEST(CIMDateTime, TellsTheTime) {
  const CIMDateTime now = CIMDateTime::getCurrentDateTime();
  EXPECT_FALSE(now.isInterval());
  EXPECT_TRUE(CIMDateTime(now.toString()) == now);
  const CIMDateTime epoch("19700101000000.000000+000");
  const Sint64 seconds = CIMDateTime::getDifference(epoch, now) / 1000000;
  EXPECT_NEAR(double(seconds), double(std::time(nullptr)), 5.0);
}

}  // namespace
