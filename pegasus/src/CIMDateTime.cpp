#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Common/Exception.h>

#include <algorithm>
#include <cstdio>
#include <ctime>

PEGASUS_NAMESPACE_BEGIN

namespace {

constexpr Uint32 kLength = 25;
constexpr Uint32 kDigits = 20;      // before the sign, without the dot
constexpr Uint32 kMicroDigits = 6;  // of them
constexpr Uint64 kSecond = 1000000;
constexpr Uint64 kMinute = 60 * kSecond;
constexpr Uint64 kHour = 60 * kMinute;
constexpr Uint64 kDay = 24 * kHour;
constexpr Uint64 kIntervalEnd = 100000000 * kDay;

struct Date {
  Uint32 year;
  Uint32 month;
  Uint32 day;
};

bool isLeapYear(Uint32 year) {
  return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
}

Uint32 daysInMonth(Uint32 year, Uint32 month) {
  constexpr Uint32 kDays[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  return kDays[month - 1] + (month == 2 && isLeapYear(year) ? 1 : 0);
}

// Days from the start of the year 0, itself a leap year, to the start of `year` (Gregorian rules).
Uint32 daysBeforeYear(Uint32 year) {
  return year == 0 ? 0 : 365 * year + (year - 1) / 4 - (year - 1) / 100 + (year - 1) / 400 + 1;
}

Uint64 daysBefore(const Date& date) {
  Uint32 days = daysBeforeYear(date.year) + date.day - 1;
  for (Uint32 month = 1; month < date.month; ++month) days += daysInMonth(date.year, month);
  return days;
}

Date dateOf(Uint64 days) {
  Uint32 year = Uint32(days / 366);  // not too late, and early by 20 at most
  while (daysBeforeYear(year + 1) <= days) ++year;
  Uint32 day = Uint32(days) - daysBeforeYear(year);
  Uint32 month = 1;
  while (day >= daysInMonth(year, month)) day -= daysInMonth(year, month++);
  return {year, month, day + 1};
}

const Uint64 kTimeStampEnd = daysBeforeYear(10000) * kDay;

// The text as its 20 digits: the dot and everything from the sign on left out.
struct Digits {
  char text[kDigits];
  Uint32 wildcards = 0;

  // A field that is all `*` reads as `wildcard`.
  Uint32 number(Uint32 from, Uint32 to, Uint32 wildcard = 0) const {
    if (from >= kDigits - wildcards) return wildcard;
    Uint32 value = 0;
    for (Uint32 i = from; i < to && text[i] != '*'; ++i) value = 10 * value + Uint32(text[i] - '0');
    for (Uint32 i = std::max(from, kDigits - wildcards); i < to; ++i) value *= 10;
    return value;
  }
};

bool isDigit(char c) {
  return c >= '0' && c <= '9';
}

// Whether so many `*` at the end cover whole fields (any number within the microseconds).
bool coverFields(Uint32 wildcards, bool interval) {
  if (wildcards <= 12) return wildcards <= kMicroDigits || wildcards % 2 == 0;
  return wildcards == kDigits || (!interval && (wildcards == 14 || wildcards == 16));
}

Digits digitsOf(const char (&text)[kLength], bool interval) {
  Digits digits;
  std::copy_n(text, 14, digits.text);
  std::copy_n(text + 15, kMicroDigits, digits.text + 14);
  Uint32 used = kDigits;
  while (used > 0 && digits.text[used - 1] == '*') --used;
  digits.wildcards = kDigits - used;
  const bool wellFormed = text[14] == '.' &&
                          std::all_of(digits.text, digits.text + used, isDigit) &&
                          coverFields(digits.wildcards, interval);
  if (!wellFormed) throw InvalidDateTimeFormatException();
  return digits;
}

Uint64 dayNumber(const Digits& digits, bool interval) {
  if (interval) return digits.number(0, 8, 1);
  const Date date{digits.number(0, 4), digits.number(4, 6, 1), digits.number(6, 8, 1)};
  if (date.month < 1 || date.month > 12) throw DateTimeOutOfRangeException("illegal month number");
  if (date.day < 1 || date.day > daysInMonth(date.year, date.month)) {
    throw DateTimeOutOfRangeException("illegal day number");
  }
  return daysBefore(date);
}

Uint64 timeOfDay(const Digits& digits) {
  const Uint32 hours = digits.number(8, 10);
  const Uint32 minutes = digits.number(10, 12);
  const Uint32 seconds = digits.number(12, 14);
  if (hours > 23) throw DateTimeOutOfRangeException("illegal hours number ");
  if (minutes > 59) throw DateTimeOutOfRangeException("illegal minutes number ");
  if (seconds > 59) throw DateTimeOutOfRangeException("illegal seconds number ");
  return hours * kHour + minutes * kMinute + seconds * kSecond + digits.number(14, kDigits);
}

// The length of the span that `wildcards` digits leave open, starting at `start`.
Uint64 openSpan(Uint64 start, Uint32 wildcards, bool interval) {
  if (wildcards == kDigits) return interval ? kIntervalEnd : kTimeStampEnd;
  if (wildcards >= 14) {
    const Date date = dateOf(start / kDay);
    return kDay * (wildcards == 14         ? daysInMonth(date.year, date.month)
                   : isLeapYear(date.year) ? 366
                                           : 365);
  }
  if (wildcards > kMicroDigits) {
    constexpr Uint64 kSpans[] = {kMinute, kHour, kDay};
    return kSpans[(wildcards - kMicroDigits) / 2 - 1];
  }
  Uint64 span = 1;
  for (Uint32 i = 0; i < wildcards; ++i) span *= 10;
  return span;
}

void requireSameKind(bool interval1, bool interval2) {
  if (interval1 != interval2) {
    throw TypeMismatchException("Trying to compare CIMDateTime objects of differing types");
  }
}

}  // namespace

CIMDateTime::CIMDateTime() : microSeconds_(0), utcOffset_(0), wildcards_(0), interval_(true) {}

CIMDateTime::CIMDateTime(const String& text) : CIMDateTime() {
  set(text);
}

CIMDateTime::CIMDateTime(Uint64 microSeconds, Boolean isInterval)
    : microSeconds_(microSeconds), utcOffset_(0), wildcards_(0), interval_(isInterval) {
  if (microSeconds >= (isInterval ? kIntervalEnd : kTimeStampEnd)) {
    throw DateTimeOutOfRangeException(
        isInterval ? "Cannot create a CIMDateTime interval greater than 100 million days"
                   : "Cannot create a CIMDateTime time stamp beyond the year 10,000");
  }
}

String CIMDateTime::toString() const {
  const Uint64 days = microSeconds_ / kDay;
  char text[64];
  if (interval_) {
    std::snprintf(text, sizeof text, "%08u", unsigned(days));
  } else {
    const Date date = dateOf(days);
    std::snprintf(text, sizeof text, "%04u%02u%02u", date.year, date.month, date.day);
  }
  std::snprintf(text + 8, sizeof text - 8, "%02u%02u%02u.%06u",
                unsigned(microSeconds_ / kHour % 24), unsigned(microSeconds_ / kMinute % 60),
                unsigned(microSeconds_ / kSecond % 60), unsigned(microSeconds_ % kSecond));
  const Uint32 fixed = kDigits - wildcards_;
  for (Uint32 i = fixed; i < kDigits; ++i) text[i < 14 ? i : i + 1] = '*';
  std::snprintf(text + 21, sizeof text - 21, "%c%03u",
                interval_        ? ':'
                : utcOffset_ < 0 ? '-'
                                 : '+',
                unsigned(utcOffset_ < 0 ? -utcOffset_ : utcOffset_));
  return String(text, kLength);
}

void CIMDateTime::set(const String& text) {
  clear();
  char ascii[kLength];
  if (text.size() != kLength) throw InvalidDateTimeFormatException();
  for (Uint32 i = 0; i < kLength; ++i) {
    const Uint16 unit = text.getChar16Data()[i];
    ascii[i] = static_cast<char>(unit < 0x80 ? unit : 0);
  }
  const char sign = ascii[21];
  const bool interval = sign == ':';
  const bool wellFormed = (interval || sign == '+' || sign == '-') &&
                          std::all_of(ascii + 22, ascii + kLength,
                                      interval ? [](char c) { return c == '0'; } : isDigit);
  if (!wellFormed) throw InvalidDateTimeFormatException();
  const Digits digits = digitsOf(ascii, interval);
  const Uint64 days = dayNumber(digits, interval);
  microSeconds_ = days * kDay + timeOfDay(digits);
  const int offset = 100 * (ascii[22] - '0') + 10 * (ascii[23] - '0') + (ascii[24] - '0');
  utcOffset_ = Sint16(sign == '-' ? -offset : offset);
  wildcards_ = Uint8(digits.wildcards);
  interval_ = interval;
}

void CIMDateTime::clear() {
  *this = CIMDateTime();
}

CIMDateTime CIMDateTime::getCurrentDateTime() {
  timespec now{};
  clock_gettime(CLOCK_REALTIME, &now);
  tm local{};
  localtime_r(&now.tv_sec, &local);
  const Date date{Uint32(local.tm_year + 1900), Uint32(local.tm_mon + 1), Uint32(local.tm_mday)};
  CIMDateTime result;
  result.microSeconds_ = daysBefore(date) * kDay + Uint32(local.tm_hour) * kHour +
                         Uint32(local.tm_min) * kMinute +
                         Uint32(std::min(local.tm_sec, 59)) * kSecond + Uint64(now.tv_nsec) / 1000;
  result.utcOffset_ = Sint16(local.tm_gmtoff / 60);
  result.interval_ = false;
  return result;
}

Sint64 CIMDateTime::getDifference(CIMDateTime start, CIMDateTime finish) {
  if (start.interval_ != finish.interval_) throw InvalidDateTimeFormatException();
  return Sint64(finish.earliest() - start.earliest());
}

Boolean CIMDateTime::isInterval() const {
  return interval_;
}
Boolean CIMDateTime::isInterval() {
  return interval_;
}

// The first and the last instant (in UTC) that the value may stand for. What is left open takes its
// part of the offset with it. Before the year 0 the count goes round, as the server's does.
Uint64 CIMDateTime::earliest() const {
  constexpr Uint32 kNoMinutes = 10;
  constexpr Uint32 kNoHours = 12;
  if (wildcards_ >= kNoHours) return microSeconds_;
  const int minutes = wildcards_ >= kNoMinutes ? utcOffset_ / 60 * 60 : utcOffset_;
  return microSeconds_ - Uint64(minutes * Sint64(kMinute));
}

Uint64 CIMDateTime::latest() const {
  return earliest() + openSpan(microSeconds_, wildcards_, interval_) - 1;
}

Boolean CIMDateTime::equal(const CIMDateTime& x) const {
  requireSameKind(interval_, x.interval_);
  if (wildcards_ == kDigits || x.wildcards_ == kDigits) return true;
  return earliest() <= x.latest() && x.earliest() <= latest();
}

Uint64 CIMDateTime::toMicroSeconds() const {
  return earliest();
}

Boolean CIMDateTime::operator<(const CIMDateTime& x) const {
  return !equal(x) && earliest() < x.earliest();
}

Boolean CIMDateTime::operator<=(const CIMDateTime& x) const {
  return equal(x) || *this < x;
}
Boolean CIMDateTime::operator>(const CIMDateTime& x) const {
  return x < *this;
}
Boolean CIMDateTime::operator>=(const CIMDateTime& x) const {
  return x <= *this;
}
Boolean CIMDateTime::operator!=(const CIMDateTime& x) const {
  return !equal(x);
}

bool operator==(const CIMDateTime& x, const CIMDateTime& y) {
  return x.equal(y);
}

PEGASUS_NAMESPACE_END
