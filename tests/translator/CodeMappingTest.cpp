// The mapping of infrastructure codes into the driver's status range, at
// both ends of every range, just outside them, and back.
#include <gtest/gtest.h>

#include <cstdint>

#include "errors/translator/CodeMapping.h"

namespace hsdig::translator {
namespace {

constexpr int32_t ivi(uint32_t code) {
  return static_cast<int32_t>(code);
}

struct RangeCase {
  const char* name;
  int32_t low, high;              // original codes
  int32_t mappedLow, mappedHigh;  // where low and high land
};

// In the first two rows the code of smallest magnitude lands at the start of
// the target; in the others the upper end of the range lands at the upper
// end of the target.
const RangeCase kRanges[] = {
    {"infrastructure errors", -52256, -52000, ivi(0xBFFA9500), ivi(0xBFFA9400)},
    {"infrastructure warnings", 52000, 52256, ivi(0x3FFA9400), ivi(0x3FFA9500)},
    {"-223899..-223800", -223899, -223800, ivi(0xBFFA479C), ivi(0xBFFA47FF)},
    {"-224699..-224600", -224699, -224600, ivi(0xBFFA4738), ivi(0xBFFA479B)},
    {"-201023..-200000", -201023, -200000, ivi(0xBFFA4800), ivi(0xBFFA4BFF)},
    {"-51023..-50000", -51023, -50000, ivi(0xBFFA6400), ivi(0xBFFA67FF)},
    {"-89999..-88000", -89999, -88000, ivi(0xBFFA6830), ivi(0xBFFA6FFF)},
    {"-10999..-10000", -10999, -10000, ivi(0xBFFA6018), ivi(0xBFFA63FF)},
    {"-309799..-309700", -309799, -309700, ivi(0xBFFA7001), ivi(0xBFFA7064)},
};

TEST(CodeMapping, BothEndsOfEveryRangeAndBack) {
  for (const auto& r : kRanges) {
    SCOPED_TRACE(r.name);
    EXPECT_EQ(cvmxl_mapErrorCode(r.low), r.mappedLow);
    EXPECT_EQ(cvmxl_mapErrorCode(r.high), r.mappedHigh);
    EXPECT_EQ(cvmxl_unmapErrorCode(r.mappedLow), r.low);
    EXPECT_EQ(cvmxl_unmapErrorCode(r.mappedHigh), r.high);
    // Linear inside: the neighbour of an end maps next to the end's target.
    int32_t step = r.mappedHigh > r.mappedLow ? 1 : -1;
    EXPECT_EQ(cvmxl_mapErrorCode(r.low + 1), r.mappedLow + step);
  }
}

TEST(CodeMapping, JustOutsideEveryRangeStaysUnchanged) {
  for (const auto& r : kRanges) {
    SCOPED_TRACE(r.name);
    // The neighbours outside may belong to the positive mirror only when the
    // range is negative; either way they are not mapped into this target.
    for (int32_t outside : {r.low - 1, r.high + 1}) {
      SCOPED_TRACE(outside);
      int32_t mapped = cvmxl_mapErrorCode(outside);
      EXPECT_EQ(mapped, outside);
    }
  }
}

TEST(CodeMapping, PositiveMirrorsAreTheNegatedMapping) {
  for (const auto& r : kRanges) {
    if (r.high > 0 || r.low == -52256) continue;  // the infrastructure rows have their own warnings
    SCOPED_TRACE(r.name);
    for (int32_t magnitude : {-r.high, -r.low, -r.low - 1}) {
      SCOPED_TRACE(magnitude);
      int32_t mapped = cvmxl_mapErrorCode(magnitude);
      EXPECT_EQ(mapped, -cvmxl_mapErrorCode(-magnitude));
      EXPECT_GT(mapped, 0);
      EXPECT_EQ(cvmxl_unmapErrorCode(mapped), magnitude);
    }
    EXPECT_EQ(cvmxl_mapErrorCode(-r.high - 1), -r.high - 1);
    EXPECT_EQ(cvmxl_mapErrorCode(-r.low + 1), -r.low + 1);
  }
  EXPECT_EQ(cvmxl_mapErrorCode(223800), ivi(0x4005B801));
}

TEST(CodeMapping, InverseHoldsForEveryMappedCode) {
  for (const auto& r : kRanges) {
    SCOPED_TRACE(r.name);
    for (int32_t code = r.low; code <= r.high; ++code) {
      int32_t mapped = cvmxl_mapErrorCode(code);
      ASSERT_NE(mapped, code) << code;
      ASSERT_EQ(cvmxl_unmapErrorCode(mapped), code) << code;
      if (r.high < 0 && r.low != -52256) {
        ASSERT_EQ(cvmxl_unmapErrorCode(cvmxl_mapErrorCode(-code)), -code) << -code;
      }
    }
  }
}

TEST(CodeMapping, OtherCodesPassUnchanged) {
  for (int32_t code : {0, 1, -1, -51999, -52257, 51999, 52257, ivi(0xBFFA1190), ivi(0xBFFA9157),
                       ivi(0x80000000), 0x7FFFFFFF, -9999, -11000, -309800, -309699}) {
    SCOPED_TRACE(code);
    EXPECT_EQ(cvmxl_mapErrorCode(code), code);
    EXPECT_EQ(cvmxl_unmapErrorCode(code), code);
  }
  // Just outside the targets nothing is moved back.
  for (uint32_t code :
       {0xBFFA93FFu, 0xBFFA9501u, 0xBFFA4737u, 0xBFFA4C00u, 0xBFFA7000u, 0xBFFA7065u}) {
    SCOPED_TRACE(code);
    EXPECT_EQ(cvmxl_unmapErrorCode(ivi(code)), ivi(code));
  }
  EXPECT_EQ(cvmxl_mapErrorCode(-52003), ivi(0xBFFA9403));
}

}  // namespace
}  // namespace hsdig::translator
