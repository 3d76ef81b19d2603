#pragma once

#include "cimhost/xml/XmlElement.h"

#include <optional>
#include <string>
#include <string_view>

namespace cimhost {

/// A document that is well-formed XML.
struct XmlDocument {
  XmlElement root;      ///< Only its attributes count when there is a problem.
  std::string problem;  ///< Why it does not follow the rules of CIM-XML; empty when it does.
};

/// What one text may hold: client input must not shape how much memory or stack is used.
struct XmlLimits {
  static constexpr std::size_t kBytes = 64u << 20;
  static constexpr std::size_t kDepth = 64;
  static constexpr std::size_t kParts = 200000;  ///< Elements and attributes together.
  static constexpr int kAttributes = 16;         ///< Of one element.
};

/// Reads a text whose root is one of `roots` (names, separated by blanks).
///
/// UTF-8, UTF-16, ISO-8859-1 and US-ASCII. There are no entities but the five of XML: a document
/// type declaration, like everything beyond the limits, is request-not-valid at once. Throws
/// HttpError with request-not-well-formed or request-not-valid.
XmlDocument readXml(std::string_view text, std::string_view roots);

}  // namespace cimhost
