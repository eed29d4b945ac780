#include "errors/translator/CodeMapping.h"

namespace hsdig::translator {

namespace {

constexpr int32_t ivi(uint32_t code) {
  return static_cast<int32_t>(code);
}

// One row per mapped range. `low`..`high` are the original codes and
// `target` is where `high` lands when `highToTop` is set (the rest linearly
// below it), or where the code of smallest magnitude lands otherwise.
struct Range {
  int32_t low;
  int32_t high;
  int32_t target;
  bool mirrored;  // the positive range of the same magnitudes maps to the negation
};

// The first row grows upwards from its target in magnitude; in every other
// row the upper end of the range maps to the upper end of the target.
constexpr Range kInfrastructure{-52256, -52000, ivi(0xBFFA9400), false};
constexpr Range kInfrastructureWarnings{52000, 52256, ivi(0x3FFA9400), false};
constexpr Range kRanges[] = {
    {-223899, -223800, ivi(0xBFFA47FF), true}, {-224699, -224600, ivi(0xBFFA479B), true},
    {-201023, -200000, ivi(0xBFFA4BFF), true}, {-51023, -50000, ivi(0xBFFA67FF), true},
    {-89999, -88000, ivi(0xBFFA6FFF), true},   {-10999, -10000, ivi(0xBFFA63FF), true},
    {-309799, -309700, ivi(0xBFFA7064), true},
};

constexpr bool within(int64_t code, int64_t low, int64_t high) {
  return code >= low && code <= high;
}

constexpr int32_t map(int32_t code) {
  if (within(code, kInfrastructure.low, kInfrastructure.high)) {
    return kInfrastructure.target + (-code - 52000);
  }
  if (within(code, kInfrastructureWarnings.low, kInfrastructureWarnings.high)) {
    return kInfrastructureWarnings.target + (code - 52000);
  }
  for (const Range& r : kRanges) {
    if (within(code, r.low, r.high)) return r.target - (r.high - code);
    // The positive mirror: the same magnitudes as warnings, mapped to the
    // negation of the negative mapping (223800 becomes 0x4005B801).
    if (r.mirrored && within(code, -int64_t{r.high}, -int64_t{r.low})) {
      return -(r.target - (r.high + code));
    }
  }
  return code;
}

constexpr int32_t unmap(int32_t code) {
  const int64_t c = code;
  if (within(c, kInfrastructure.target, int64_t{kInfrastructure.target} + 256)) {
    return -52000 - (code - kInfrastructure.target);
  }
  if (within(c, kInfrastructureWarnings.target, int64_t{kInfrastructureWarnings.target} + 256)) {
    return 52000 + (code - kInfrastructureWarnings.target);
  }
  for (const Range& r : kRanges) {
    const int64_t span = int64_t{r.high} - r.low;
    if (within(c, int64_t{r.target} - span, r.target)) return r.high - (r.target - code);
    if (r.mirrored && within(-c, int64_t{r.target} - span, r.target)) {
      return -(r.high - (r.target + code));
    }
  }
  return code;
}

// The examples every caller relies on, checked at compile time.
static_assert(map(-52000) == ivi(0xBFFA9400));
static_assert(map(-52003) == ivi(0xBFFA9403));
static_assert(map(-52256) == ivi(0xBFFA9500));
static_assert(map(52000) == ivi(0x3FFA9400));
static_assert(map(223800) == ivi(0x4005B801));
static_assert(map(-223899) == ivi(0xBFFA479C));
static_assert(map(-201023) == ivi(0xBFFA4800));
static_assert(map(ivi(0xBFFA1190)) == ivi(0xBFFA1190));
static_assert(unmap(map(-309799)) == -309799);

}  // namespace

int32_t cvmxl_mapErrorCode(int32_t code) noexcept {
  return map(code);
}

int32_t cvmxl_unmapErrorCode(int32_t code) noexcept {
  return unmap(code);
}

}  // namespace hsdig::translator
