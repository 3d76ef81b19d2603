#pragma once

#include <Pegasus/Common/Array.h>

PEGASUS_NAMESPACE_BEGIN

/// A time stamp `yyyymmddhhmmss.mmmmmmsutc` or an interval `ddddddddhhmmss.mmmmmm:000` (DMTF
/// DSP0004, datetime type); the zero interval by default.
///
/// Trailing fields may be `*`, and so may trailing digits of the microseconds. Time stamps compare
/// as instants in UTC; a `*` matches anything. Comparing a time stamp with an interval throws
/// TypeMismatchException.
class PEGASUS_COMMON_LINKAGE CIMDateTime {
 public:
  CIMDateTime();
  /// Throws InvalidDateTimeFormatException or DateTimeOutOfRangeException.
  CIMDateTime(const String& text);
  /// Microseconds of the interval, or since the start of the year 0 in UTC; throws
  /// DateTimeOutOfRangeException.
  CIMDateTime(Uint64 microSeconds, Boolean isInterval);

  /// 25 characters.
  String toString() const;
  /// Throws as the constructor does, and leaves the zero interval then.
  void set(const String& text);
  void clear();

  static CIMDateTime getCurrentDateTime();
  /// `finish` - `start` in microseconds; both must be of the same kind.
  static Sint64 getDifference(CIMDateTime start, CIMDateTime finish);

  Boolean isInterval() const;
  Boolean isInterval();
  Boolean equal(const CIMDateTime& x) const;
  /// What the constructor from microseconds takes; `*` counts as 0.
  Uint64 toMicroSeconds() const;

  Boolean operator<(const CIMDateTime& x) const;
  Boolean operator<=(const CIMDateTime& x) const;
  Boolean operator>(const CIMDateTime& x) const;
  Boolean operator>=(const CIMDateTime& x) const;
  Boolean operator!=(const CIMDateTime& x) const;

 private:
  Uint64 earliest() const;
  Uint64 latest() const;

  Uint64 microSeconds_;  // local time of a time stamp, since the start of the year 0
  Sint16 utcOffset_;     // minutes
  Uint8 wildcards_;      // how many of the 20 digits before the sign are `*`, from the right
  Boolean interval_;
};

PEGASUS_COMMON_LINKAGE bool operator==(const CIMDateTime& x, const CIMDateTime& y);

PEGASUS_NAMESPACE_END
