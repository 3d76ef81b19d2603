#include <Pegasus/Common/CIMDateTime.h>

#include <ctime>
#include <tuple>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

const char kZero[] = "00000000000000.000000:000";

CIMDateTime of(const char* digits) {
  return CIMDateTime(String(digits));
}

TEST(CIMDateTime, KeepsWellFormedText) {
  for (const char* given :
       {"20260101120000.000000+060", "20260101120000.123456-999", "99991231235959.999999+000",
        "00000101120000.000000+000", "20240229120000.000000+000", "20000229000000.000000+000",
        "12345678231559.123456:000", "99999999235959.999999:000", "20260101120000.******+060",
        "20260101120000.12345*+060", "202601011200**.******+060", "2026010112****.******+060",
        "20260101******.******+060", "202602********.******+060", "2026**********.******+060",
        "**************.******+000", "00000001******.******:000", "**************.******:000"}) {
    SCOPED_TRACE(given);
    const CIMDateTime value = of(given);
    EXPECT_EQ(text(value.toString()), given);
    EXPECT_EQ(value.isInterval(), given[21] == ':');
    EXPECT_TRUE(value == value);
    EXPECT_FALSE(value < value);
  }
  EXPECT_EQ(text(CIMDateTime().toString()), kZero);
  EXPECT_EQ(text(of("20260101120000.000000-000").toString()), "20260101120000.000000+000");
}

TEST(CIMDateTime, RefusesDigitsOutOfRange) {
  const std::pair<const char*, std::string> cases[] = {
      {"20260229120000.000000+000", "day"},     {"19000229120000.000000+000", "day"},
      {"20260100120000.000000+000", "day"},     {"20261301120000.000000+000", "month"},
      {"20260001120000.000000+000", "month"},   {"20260101240000.000000+000", "hours"},
      {"00000001240000.000000:000", "hours"},   {"20260101126000.000000+000", "minutes"},
      {"20260101120060.000000+000", "seconds"},
  };
  for (const auto& [given, field] : cases) {
    const std::string space = field.back() == 's' ? " " : "";
    EXPECT_EQ(thrownMessage<DateTimeOutOfRangeException>([given = given] { of(given); }),
              "DateTime is out of range : illegal " + field + " number" + space);
  }
}

TEST(CIMDateTime, RefusesMalformedText) {
  for (const char* malformed :
       {"", "20260101120000.000000+0600", "20260101120000,000000+060", "20260101120000.000000*060",
        "00000001000000.000000:001", "20260101120000.12*4**+060", "2026010112****.000000+060",
        "20260101120000.000000+***", "20260101120***.******+060", "202601*********.*****+060",
        "00000*********.******:000", "2*************.******+000", "20260101120000.000000+-60",
        "20260101120000.00000 +060", "2026010112000\xC3\xA9.000000+060"}) {
    CIMDateTime value("20260101120000.000000+060");
    EXPECT_EQ(thrownMessage<InvalidDateTimeFormatException>([&] { value.set(malformed); }),
              "invalid datetime format");
    EXPECT_EQ(text(value.toString()), kZero) << malformed;
  }
  EXPECT_THROW(CIMDateTime(String("2026010112\000000.000000+060", 25)),
               InvalidDateTimeFormatException);
  EXPECT_THROW(of(std::string(1 << 20, '0').c_str()), InvalidDateTimeFormatException);
}

TEST(CIMDateTime, ComparesInstants) {
  const std::tuple<const char*, const char*, int> cases[] = {
      {"20260101000000.000000+060", "20251231230000.000000+000", 0},
      {"20260101120000.000000+060", "20260101120000.000000+000", -1},
      {"20260101120000.000001+000", "20260101120000.000000+000", 1},
      {"20240301000000.000000+000", "20240229235959.999999+000", 1},
      {"20260101120000.******+000", "20260101120000.999999+000", 0},
      {"202602********.******+000", "20260228235959.999999+000", 0},
      {"2026**********.******+000", "20251231235959.999999+000", 1},
      {"2024**********.******+000", "20241231235959.999999+000", 0},
      {"**************.******+000", "99991231235959.999999-999", 0},
      // The offset counts for what is given: all of it, its hours, nothing.
      {"202601011200**.******+090", "20260101103000.000000+000", 0},
      {"2026010112****.******+090", "20260101115959.999999+000", 0},
      {"2026010112****.******-090", "20260101125959.999999+000", 1},
      {"20260101******.******+060", "20251231235959.999999+000", 1},
      // Before the year 0 in UTC the count goes round.
      {"00000101000000.000000+001", "99991231235959.999999+000", 1},
      {"00000000000000.000001:000", kZero, 1},
      {"**************.******:000", "99999999235959.999999:000", 0},
  };
  for (const auto& [left, right, order] : cases) {
    SCOPED_TRACE(std::string(left) + " / " + right);
    const CIMDateTime a = of(left), b = of(right);
    EXPECT_TRUE((a == b) == (order == 0) && (a != b) == (order != 0));
    EXPECT_TRUE((a < b) == (order < 0) && (b > a) == (order < 0));
    EXPECT_TRUE((a <= b) == (order <= 0) && (b >= a) == (order <= 0));
  }
}

TEST(CIMDateTime, RefusesToCompareDifferentKinds) {
  const CIMDateTime stamp("20260101120000.000000+060");
  const char message[] = "type mismatch: Trying to compare CIMDateTime objects of differing types";
  EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { stamp.equal(CIMDateTime()); }), message);
  EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { (void)(stamp < CIMDateTime()); }), message);
  EXPECT_THROW(CIMDateTime::getDifference(stamp, CIMDateTime()), InvalidDateTimeFormatException);
}

TEST(CIMDateTime, CountsMicroSeconds) {
  EXPECT_EQ(text(CIMDateTime(90061000001ULL, true).toString()), "00000001010101.000001:000");
  // From the year 0 to 1970: 719528 days.
  const CIMDateTime epoch("19700101000000.000000+000");
  EXPECT_EQ(epoch.toMicroSeconds(), 719528ULL * 86400000000ULL);
  EXPECT_TRUE(CIMDateTime(epoch.toMicroSeconds(), false) == epoch);
  EXPECT_EQ(CIMDateTime::getDifference(epoch, of("19700101000000.000000+001")), -60000000);
  EXPECT_EQ(of("00000101000000.000000+001").toMicroSeconds(), Uint64(-60000000));
  EXPECT_EQ(of("20260101******.******+060").toMicroSeconds(), 63934444800000000ULL);
  EXPECT_EQ(of("**************.******:000").toMicroSeconds(), 86400000000ULL);
  const std::string outOfRange = "DateTime is out of range : Cannot create a CIMDateTime ";
  EXPECT_EQ(thrownMessage<DateTimeOutOfRangeException>([] { CIMDateTime(~0ULL, true); }),
            outOfRange + "interval greater than 100 million days");
  EXPECT_EQ(thrownMessage<DateTimeOutOfRangeException>([] { CIMDateTime(~0ULL, false); }),
            outOfRange + "time stamp beyond the year 10,000");
  const CIMDateTime now = CIMDateTime::getCurrentDateTime();
  EXPECT_TRUE(CIMDateTime(now.toString()) == now);
  EXPECT_NEAR(double(CIMDateTime::getDifference(epoch, now) / 1000000), double(std::time(nullptr)),
              5.0);
}

}  // namespace
