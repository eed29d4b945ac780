// The engine binding against no engine, an engine that lacks a required
// function, and one that lacks optional functions.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <string>

#include "errors/Exception.h"
#include "session/IviEngineBinding.h"
#include "session/IviWrapper.h"

namespace hsdig {
namespace {

namespace fs = std::filesystem;

// The folder the build puts shared objects in, beside this program's.
fs::path libraryFolder() {
  return fs::read_symlink("/proc/self/exe").parent_path() / ".." / "lib";
}

TEST(EngineBinding, NoEngineAnswersNotLoadedAndItsOwnMessage) {
  IviEngineBinding binding({"libhsdig-no-such-engine.so", "/nonexistent/libivi.so"});
  ViSession vi = 0;
  EXPECT_EQ(binding.Ivi_SpecificDriverNew("hsdig", "", &vi), kEngineNotLoaded);
  EXPECT_EQ(binding.Ivi_ClearErrorInfo(1), kEngineNotLoaded);
  EXPECT_EQ(binding.Ivi_Simulating(1), VI_FALSE);
  EXPECT_EQ(binding.Ivi_GetPtrToSpecialViReal64Value(IVI_VAL_TYPE_NAN), nullptr);
  EXPECT_EQ(binding.IviScope_InterchangeCheck(1, "f"), kEngineNotLoaded);
  EXPECT_FALSE(binding.isLoaded());
  EXPECT_NE(binding.lastLoadFailure(), "");

  char message[IVI_MAX_MESSAGE_BUF_SIZE] = "untouched";
  EXPECT_EQ(binding.Ivi_GetErrorMessage(kEngineNotLoaded, message), VI_SUCCESS);
  EXPECT_STREQ(message, "Unable to load IVI Engine (ivi.dll)");
  std::snprintf(message, sizeof message, "untouched");
  EXPECT_EQ(binding.Ivi_GetErrorMessage(-1, message), kEngineNotLoaded);
  EXPECT_STREQ(message, "untouched");

  // Through a wrapper, in both modes.
  IviWrapper wrapper(0, binding);
  EXPECT_EQ(wrapper.getErrorMessage(kEngineNotLoaded, message), VI_SUCCESS);
  EXPECT_STREQ(message, "Unable to load IVI Engine (ivi.dll)");
  EXPECT_EQ(wrapper.clearErrorInfo(1), kEngineNotLoaded);
  try {
    wrapper.clearErrorInfo();
    ADD_FAILURE() << "no exception";
  } catch (const Exception& e) {
    EXPECT_EQ(e.status().code(), kEngineNotLoaded);
  }
}

TEST(EngineBinding, MissingRequiredFunctionFailsAndIsRetriedOnTheNextCall) {
  const fs::path folder = fs::path(::testing::TempDir()) / ("binding-" + std::to_string(getpid()));
  fs::create_directories(folder);
  const fs::path engine = folder / "libengine.so";
  fs::copy_file(libraryFolder() / "libivi_missing_required.so", engine,
                fs::copy_options::overwrite_existing);

  IviEngineBinding binding({engine.string()});
  ViSession vi = 0;
  EXPECT_EQ(binding.Ivi_SpecificDriverNew("hsdig", "", &vi), kEngineFunctionMissing);
  EXPECT_NE(binding.lastLoadFailure().find("Ivi_GetAttributeViInt32"), std::string::npos);
  EXPECT_EQ(binding.Ivi_SpecificDriverNew("hsdig", "", &vi), kEngineFunctionMissing);
  EXPECT_FALSE(binding.isLoaded());

  // A complete engine in its place is picked up by the next call.
  const fs::path staged = folder / "staged.so";
  fs::copy_file(libraryFolder() / "libcvivi.so", staged, fs::copy_options::overwrite_existing);
  fs::rename(staged, engine);
  ASSERT_EQ(binding.Ivi_SpecificDriverNew("hsdig", "", &vi), VI_SUCCESS);
  EXPECT_TRUE(binding.isLoaded());
  ViInt32 primary = -1;
  EXPECT_EQ(binding.Ivi_GetAttributeViInt32(vi, "", IVI_ATTR_PRIMARY_ERROR, 0, &primary),
            VI_SUCCESS);
  EXPECT_EQ(primary, 0);
  EXPECT_EQ(binding.Ivi_Dispose(vi), VI_SUCCESS);
  fs::remove_all(folder);
}

TEST(EngineBinding, MissingOptionalFunctionFailsOnlyThatCall) {
  IviEngineBinding binding({"libivi_missing_optional.so"});
  ViSession vi = 0;
  ASSERT_EQ(binding.Ivi_SpecificDriverNew("hsdig", "Simulate=1", &vi), VI_SUCCESS);
  ViInt64 value = 0;
  // Status-returning: the missing-function status for this call only.
  EXPECT_EQ(binding.Ivi_GetAttributeViInt64(vi, "", IVI_ATTR_PRIMARY_ERROR, 0, &value),
            kEngineFunctionMissing);
  ViInt32 primary = -1;
  EXPECT_EQ(binding.Ivi_GetAttributeViInt32(vi, "", IVI_ATTR_PRIMARY_ERROR, 0, &primary),
            VI_SUCCESS);
  // Value-returning and class-driver calls answer 0.
  EXPECT_EQ(binding.Ivi_SessionIsAvailable(vi), VI_FALSE);
  EXPECT_EQ(binding.IviScope_InterchangeCheck(vi, "f"), 0);
  EXPECT_EQ(binding.Ivi_Simulating(vi), VI_TRUE);
  // In throwing mode the missing function throws like any error.
  IviWrapper wrapper(vi, binding);
  EXPECT_THROW(wrapper.getAttributeViInt64("", IVI_ATTR_PRIMARY_ERROR, 0, &value), Exception);
  EXPECT_EQ(wrapper.dispose(), VI_SUCCESS);
}

// The binding's view of the table: how many functions of each kind it
// resolves and which it may do without.
TEST(EngineBinding, TableCounts) {
  struct Counts {
    int all = 0, required = 0, value = 0, classDriver = 0;
  } counts;
#define HSDIG_COUNT_KIND_STATUS
#define HSDIG_COUNT_KIND_VALUE ++counts.value;
#define HSDIG_COUNT_KIND_CLASS ++counts.classDriver;
#define HSDIG_COUNT(cname, method, avail, kind, support, ret, sess, params, args) \
  ++counts.all;                                                                   \
  counts.required += HSDIG_IVI_IS_REQUIRED(avail) ? 1 : 0;                        \
  IVI_ENGINE_CAT(HSDIG_COUNT_KIND_, kind)
  IVI_ENGINE_FUNCTIONS(HSDIG_COUNT)
#undef HSDIG_COUNT
  EXPECT_EQ(counts.all, 232);
  EXPECT_EQ(counts.required, 157);
  EXPECT_EQ(counts.all - counts.required, 75);
  EXPECT_EQ(counts.value, 16);
  EXPECT_EQ(counts.classDriver, 8);
}

TEST(EngineBinding, TheProcessBindingFindsTheEngineByItsBareName) {
  EXPECT_EQ(IviEngineBinding::defaultLibraryNames(),
            (std::vector<std::string>{"libcvivi.so", "libivi.so"}));
  EXPECT_EQ(IviEngineBinding::process().load(), VI_SUCCESS);
  EXPECT_TRUE(IviEngineBinding::process().isLoaded());
}

}  // namespace
}  // namespace hsdig
