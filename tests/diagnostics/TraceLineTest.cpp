#include "diagnostics/TraceLine.h"

#include "tests/support/StdoutCapture.h"

#include <gtest/gtest.h>

#include <climits>

TEST(TraceLine, WritesEverythingInOrderWhateverItsLength) {
  for (const size_t length : {0u, 1u, 239u, 240u, 241u, 10000u}) {
    const std::string text(length, 'x');
    StdoutCapture out;
    TraceLine() << "<" << text << INT_MIN << text << ">%d" << 0;
    EXPECT_EQ(out.text(), "<" + text + "-2147483648" + text + ">%d0") << length;
  }
}
