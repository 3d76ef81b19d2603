#pragma once

#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Common/CIMValue.h>

#include <limits>
#include <string>
#include <vector>

#include "CimText.h"

/// A CIM value and what it is as a definition value, written as the plug-in writes it: 5, 'text',
/// [1 2], ['a' 'b'].
struct ValueCase {
  Pegasus::CIMValue value;
  std::string expected;
};

inline std::ostream& operator<<(std::ostream& out, const ValueCase& given) {
  return out << textOf(given.value);
}

template <class T>
Pegasus::CIMValue arrayValue(std::initializer_list<T> elements) {
  Pegasus::Array<T> array;
  for (const T& element : elements) array.append(element);
  return Pegasus::CIMValue(array);
}

/// Every CIM type, with the values where a conversion can go wrong. A value that a property cannot
/// hold is not among them.
inline std::vector<ValueCase> valueCases() {
  using namespace Pegasus;
  const String date("20260101120000.000000-000");
  return {
      {CIMValue(Boolean(true)), "1"},
      {CIMValue(Boolean(false)), "0"},
      {CIMValue(Uint8(255)), "255"},
      {CIMValue(Sint8(-128)), "-128"},
      {CIMValue(Uint16(65535)), "65535"},
      {CIMValue(Sint16(-32768)), "-32768"},
      {CIMValue(Uint32(4294967295u)), "-1"},
      {CIMValue(Sint32(-5)), "-5"},
      {CIMValue(Uint64(0x100000005ull)), "5"},
      {CIMValue(Uint64(0x100000000ull)), "0"},
      {CIMValue(Uint64(0x80000000ull)), "-2147483648"},
      {CIMValue(Sint64(-1)), "-1"},
      {CIMValue(Real32(2.9f)), "2"},
      {CIMValue(Real64(-2.9)), "-2"},
      {CIMValue(Real64(1e300)), "2147483647"},
      {CIMValue(-std::numeric_limits<Real64>::infinity()), "-2147483648"},
      {CIMValue(std::numeric_limits<Real32>::quiet_NaN()), "0"},
      {CIMValue(Char16(0xFFFE)), "65534"},
      {CIMValue(String("\xc3\xa9 %s")), "'\xc3\xa9 %s'"},
      {CIMValue(CIMDateTime(date)), "'20260101120000.000000+000'"},
      {CIMValue(CIMObjectPath(String("root/t:B.z=1,a=\"x\""))), "'root/t:B.a=\"x\",z=1'"},
      {arrayValue<Boolean>({true, false}), "[1 0]"},
      {arrayValue<Uint8>({0, 255}), "[0 255]"},
      {arrayValue<Sint8>({-1}), "[-1]"},
      {arrayValue<Uint16>({65535}), "[65535]"},
      {arrayValue<Sint16>({-1}), "[-1]"},
      {arrayValue<Uint32>({4294967295u, 1}), "[-1 1]"},
      {arrayValue<Sint32>({}), "[]"},
      {arrayValue<Uint64>({0x100000005ull}), "[5]"},
      {arrayValue<Sint64>({-1}), "[-1]"},
      {arrayValue<Real32>({2.9f, -2.9f}), "[2 -2]"},
      {arrayValue<Real64>({1e300}), "[2147483647]"},
      {arrayValue<Char16>({Char16(65)}), "[65]"},
      {arrayValue<String>({String("a b"), String(), String("c")}), "['a b' '' 'c']"},
      {arrayValue<CIMDateTime>({CIMDateTime(date)}), "['20260101120000.000000+000']"},
  };
}
