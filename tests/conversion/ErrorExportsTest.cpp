// The error exports through their C interface: the size protocols, session 0,
// and what an unknown handle gives.
#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "errors/conversion/CallError.h"
#include "errors/conversion/RemoteErrorConverter.h"
#include "hsdigRemote/hsdigRemote.h"
#include "support/EngineSession.h"

namespace hsdig {
namespace {

class ErrorExports : public ::testing::Test {
 protected:
  void SetUp() override {
    session_.wrapper().setErrorInfo(VI_TRUE, -1074001234, kSecondaryErrorCallFrame, kText);
  }
  static constexpr const char* kText = "range 7 V is above 5 V";
  test::EngineSession session_;
};

TEST_F(ErrorExports, GetErrorSizeProtocol) {
  const ViSession vi = session_.handle();
  const ViInt32 needed = static_cast<ViInt32>(std::strlen(kText) + 1);
  struct Row {
    const char* name;
    ViInt32 size;
    bool nullBuffer;
    ViStatus result;
    const char* text;
  };
  const Row rows[] = {
      {"size 0", 0, true, needed, nullptr},
      {"exact", needed, false, 0, kText},
      {"too small", 6, false, needed, "range"},
      {"negative", -1, false, 0, kText},
      {"null buffer", 10, true, static_cast<ViStatus>(0xBFFA0058), nullptr},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.name);
    char buffer[256];
    std::memset(buffer, '#', sizeof buffer);
    ViStatus code = 0;
    EXPECT_EQ(hsdigRemote_GetError(vi, &code, row.size, row.nullBuffer ? nullptr : buffer),
              row.result);
    EXPECT_EQ(code, -1074001234) << "the code is written in every case";
    if (row.text) {
      EXPECT_STREQ(buffer, row.text);
    }
  }
  ViStatus code = 0;
  char again[256];
  EXPECT_EQ(hsdigRemote_GetError(vi, &code, sizeof again, again), 0);
  EXPECT_STREQ(again, kText) << "reading does not clear";
  EXPECT_EQ(hsdigRemote_GetError(vi, nullptr, sizeof again, again), 0) << "the code is optional";
}

TEST_F(ErrorExports, GetErrorMessageSizeProtocol) {
  const ViStatus timedOut = static_cast<ViStatus>(0xBFFA9157);
  const ViInt32 length = hsdigRemote_GetErrorMessage(session_.handle(), timedOut, 0, nullptr);
  ASSERT_GT(length, 0);
  std::string full(static_cast<size_t>(length) + 8, '#');
  EXPECT_EQ(hsdigRemote_GetErrorMessage(session_.handle(), timedOut,
                                        static_cast<ViInt32>(full.size()), full.data()),
            0);
  EXPECT_EQ(std::strlen(full.c_str()), static_cast<size_t>(length));
  EXPECT_EQ(full.back(), '\0') << "zero-filled after a shorter text";

  std::string exact(static_cast<size_t>(length) + 1, '#');
  EXPECT_EQ(hsdigRemote_GetErrorMessage(session_.handle(), timedOut, length, exact.data()), 0);
  EXPECT_EQ(exact[static_cast<size_t>(length)], '#') << "no terminator when the text fills it";

  EXPECT_EQ(hsdigRemote_GetErrorMessage(session_.handle(), timedOut, -1, full.data()),
            static_cast<ViStatus>(0xBFFA000F));
  EXPECT_EQ(hsdigRemote_GetErrorMessage(session_.handle(), timedOut, 4, nullptr),
            static_cast<ViStatus>(0xBFFA0058));

  const ViInt32 zeroLength = hsdigRemote_GetErrorMessage(session_.handle(), 0, 0, nullptr);
  std::string zero(static_cast<size_t>(zeroLength) + 1, '#');
  EXPECT_EQ(hsdigRemote_GetErrorMessage(session_.handle(), 0, zeroLength + 1, zero.data()), 0);
  EXPECT_EQ(std::string(zero.c_str()), RemoteErrorConverter::render(Status(), 0))
      << "code 0 gives the translator's text for it";
}

TEST_F(ErrorExports, ClearErrorAndSessionZero) {
  EXPECT_EQ(hsdigRemote_ClearError(session_.handle()), 0);
  ViStatus code = -1;
  char buffer[512];
  EXPECT_EQ(hsdigRemote_GetError(session_.handle(), &code, sizeof buffer, buffer), 0);
  EXPECT_EQ(code, 0);

  // Session 0 holds errors of its own (a failed open, every close).
  IviWrapper(0).setErrorInfo(VI_TRUE, -1074004444, kSecondaryErrorCallFrame, "close failed");
  EXPECT_EQ(hsdigRemote_QLGetError(0, &code, sizeof buffer, buffer), 0);
  EXPECT_EQ(code, -1074004444);
  EXPECT_STREQ(buffer, "close failed");
  EXPECT_EQ(hsdigRemote_ClearError(0), 0);
  EXPECT_EQ(hsdigRemote_GetError(0, &code, sizeof buffer, buffer), 0);
  EXPECT_EQ(code, 0);
}

TEST_F(ErrorExports, UnknownHandleGivesTheEnginesStatusUnmapped) {
  ViStatus code = 0;
  char buffer[64];
  const ViStatus status = hsdigRemote_GetError(987654, &code, sizeof buffer, buffer);
  EXPECT_LT(status, 0);
  EXPECT_EQ(mapStatusCode(status), status) << "already a driver-range code";
}

}  // namespace
}  // namespace hsdig
