// RemoteErrorConverter over a real engine and the real translator: exception
// conversion, finishCall, toReplyStatus, the error text of a session, and
// the error cache.
#include <gtest/gtest.h>

#include <functional>
#include <new>
#include <stdexcept>

#include <thrift/TApplicationException.h>
#include <thrift/protocol/TProtocolException.h>
#include <thrift/transport/TTransportException.h>

#include "errors/Exception.h"
#include "errors/conversion/CopyStringOut.h"
#include "errors/conversion/ErrorCacher.h"
#include "errors/conversion/RemoteErrorConverter.h"
#include "support/EngineSession.h"

namespace hsdig {
namespace {

using apache::thrift::TApplicationException;
using apache::thrift::protocol::TProtocolException;
using apache::thrift::transport::TTransportException;
using test::EngineSession;

RemoteErrorConverter& converter() {
  return static_cast<RemoteErrorConverter&>(remoteErrorConverter());
}

int32_t codeOf(const std::function<void()>& thrower) {
  Status status;
  try {
    thrower();
  } catch (...) {
    converter().convertCurrentException(status);
  }
  return status.code();
}

TEST(ConvertThriftException, EveryRowOfTheTable) {
  struct Row {
    const char* name;
    std::function<void()> thrower;
    uint32_t code;
  };
  auto protocol = [](TProtocolException::TProtocolExceptionType t) {
    return [t] { throw TProtocolException(t, "p"); };
  };
  auto transport = [](TTransportException::TTransportExceptionType t) {
    return [t] { throw TTransportException(t, "t"); };
  };
  const Row rows[] = {
      {"protocol invalid data", protocol(TProtocolException::INVALID_DATA), 0xBFFA9150},
      {"protocol negative size", protocol(TProtocolException::NEGATIVE_SIZE), 0xBFFA9151},
      {"protocol size limit", protocol(TProtocolException::SIZE_LIMIT), 0xBFFA9152},
      {"protocol bad version", protocol(TProtocolException::BAD_VERSION), 0xBFFA9153},
      {"protocol not implemented", protocol(TProtocolException::NOT_IMPLEMENTED), 0xBFFA9154},
      {"protocol depth limit", protocol(TProtocolException::DEPTH_LIMIT), 0xBFFA914F},
      {"protocol unknown", protocol(TProtocolException::UNKNOWN), 0xBFFA914F},
      {"transport not open", transport(TTransportException::NOT_OPEN), 0xBFFA9156},
      {"transport timed out", transport(TTransportException::TIMED_OUT), 0xBFFA9157},
      {"transport end of file", transport(TTransportException::END_OF_FILE), 0xBFFA9158},
      {"transport interrupted", transport(TTransportException::INTERRUPTED), 0xBFFA9159},
      {"transport bad args", transport(TTransportException::BAD_ARGS), 0xBFFA915A},
      {"transport corrupted data", transport(TTransportException::CORRUPTED_DATA), 0xBFFA915B},
      {"transport internal error", transport(TTransportException::INTERNAL_ERROR), 0xBFFA915C},
      {"transport unknown", transport(TTransportException::UNKNOWN), 0xBFFA9155},
      {"transport client disconnect", transport(TTransportException::CLIENT_DISCONNECT),
       0xBFFA9155},
      {"application missing result",
       [] { throw TApplicationException(TApplicationException::MISSING_RESULT, "m"); }, 0xBFFA914E},
      {"application bad sequence id",
       [] { throw TApplicationException(TApplicationException::BAD_SEQUENCE_ID, "s"); },
       0xBFFA914E},
      {"plain TException", [] { throw apache::thrift::TException("x"); }, 0xBFFA914E},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.name);
    EXPECT_EQ(static_cast<uint32_t>(codeOf(row.thrower)), row.code);
  }
}

TEST(ConvertCurrentException, CatchOrder) {
  EXPECT_EQ(codeOf([] { throw std::length_error("l"); }), -52003);
  EXPECT_EQ(codeOf([] { throw std::bad_alloc(); }), -52000);
  EXPECT_EQ(codeOf([] { throw std::runtime_error("r"); }), -52003);
  EXPECT_EQ(codeOf([] { throw HostErrorException(-7, "host"); }), -52003);

  Status status;
  try {
    throw Exception(static_cast<int32_t>(0xBFFA1190));
  } catch (...) {
    converter().convertCurrentException(status);
  }
  EXPECT_EQ(static_cast<uint32_t>(status.code()), 0xBFFA1190u);
  EXPECT_TRUE(status.description().HasMember("line")) << "the exception's description comes along";

  EXPECT_THROW(codeOf([] { throw 42; }), int) << "outside the standard hierarchy: rethrown";

  Status held(-1);
  try {
    throw Exception(-2);
  } catch (...) {
    converter().convertCurrentException(held);
  }
  EXPECT_EQ(held.code(), -1) << "an error already held stays";
}

TEST(CaptureCurrentException, HostErrorsBecomeTheCallError) {
  Status status;
  CallError call;
  try {
    throw HostErrorException(-1074000000, "overrange");
  } catch (...) {
    converter().captureCurrentException(status, call);
  }
  EXPECT_EQ(call.code, -1074000000);
  EXPECT_EQ(call.text, "overrange");
  EXPECT_EQ(status.code(), 0);

  Status failed(-52003);
  CallError later;
  try {
    throw HostErrorException(-5, "not kept");
  } catch (...) {
    converter().captureCurrentException(failed, later);
  }
  EXPECT_EQ(later.code, -5);
  EXPECT_EQ(later.text, "") << "with a local error held, the server text is not taken";

  Status other;
  CallError none;
  try {
    throw TTransportException(TTransportException::TIMED_OUT);
  } catch (...) {
    converter().captureCurrentException(other, none);
  }
  EXPECT_EQ(static_cast<uint32_t>(other.code()), 0xBFFA9157u);
  EXPECT_EQ(none.code, 0);

  bool isHost = false;
  Status untouched;
  try {
    throw HostErrorException(-9, "h");
  } catch (...) {
    converter().classifyCurrentException(untouched, isHost);
  }
  EXPECT_TRUE(isHost);
  EXPECT_EQ(untouched.code(), 0);
}

TEST(CopyStringOut, IviStringRule) {
  struct Row {
    const char* name;
    ViInt32 size;
    bool nullBuffer;
    ViStatus result;
    const char* written;  // nullptr: the buffer is untouched
  };
  const Row rows[] = {
      {"size 0 asks for the size", 0, false, 6, nullptr},
      {"size 0 with a null buffer", 0, true, 6, nullptr},
      {"null buffer", 6, true, static_cast<ViStatus>(0xBFFA0058), nullptr},
      {"exact size", 6, false, 0, "hello"},
      {"larger", 20, false, 0, "hello"},
      {"negative size trusts the caller", -1, false, 0, "hello"},
      {"too small truncates", 3, false, 6, "he"},
      {"size 1 leaves only the terminator", 1, false, 6, ""},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.name);
    char buffer[32];
    std::memset(buffer, '#', sizeof buffer);
    EXPECT_EQ(copyStringOut("hello", row.size, row.nullBuffer ? nullptr : buffer), row.result);
    if (row.written) {
      EXPECT_STREQ(buffer, row.written);
      if (row.size > 0) {
        EXPECT_EQ(buffer[row.size], '#') << "nothing past the given size";
      }
    } else {
      EXPECT_EQ(buffer[0], '#');
    }
  }
}

class WithSession : public ::testing::Test {
 protected:
  EngineSession session_;
  IviWrapper& wrapper() { return session_.wrapper(); }
  std::string text(int32_t code) { return converter().render(Status(code), 0); }
  std::string errorText(ViStatus* code = nullptr) {
    ViStatus primary = 0;
    const ViStatus needed =
        converter().getErrorText(wrapper(), &primary, 0, nullptr, 0, kSecondaryErrorCallFrame);
    EXPECT_GT(needed, 0);
    std::string buffer(static_cast<size_t>(needed), '\0');
    EXPECT_EQ(converter().getErrorText(wrapper(), &primary, needed, buffer.data(), 0,
                                       kSecondaryErrorCallFrame),
              0);
    if (code) *code = primary;
    return std::string(buffer.c_str());
  }
};

TEST_F(WithSession, FinishCallOutcomes) {
  const int32_t timedOut = static_cast<int32_t>(0xBFFA9157);
  const int32_t unknownSession = static_cast<int32_t>(0xBFFA1190);
  struct Row {
    const char* name;
    int32_t local;  // Status code of the call
    CallError reply;
    int32_t result;
    const char* description;  // nullptr: the translator's text of `result`
  };
  const Row rows[] = {
      {"server error text exactly", 0, {-1074001234, "x"}, -1074001234, "x"},
      {"server warning kept", 0, {0x3FFA0001, "coerced"}, 0x3FFA0001, "coerced"},
      {"transport time-out", timedOut, {}, timedOut, nullptr},
      {"unknown handle unmapped", unknownSession, {}, unknownSession, nullptr},
      {"out of memory mapped", -52000, {}, static_cast<int32_t>(0xBFFA9400), nullptr},
      {"internal mapped", -52003, {}, static_cast<int32_t>(0xBFFA9403), nullptr},
      {"warning then local failure: the failure wins",
       timedOut,
       {0x3FFA0001, "w"},
       timedOut,
       nullptr},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.name);
    wrapper().clearErrorInfo(1);
    Status local;
    local.set(row.local);
    std::string expectedText = row.description ? row.description : "";
    if (!row.description) {
      Status result;
      converter().translateStatus(local, 0, expectedText, result);
    }
    EXPECT_EQ(converter().finishCall(wrapper(), local, row.reply, 0, kSecondaryErrorCallFrame),
              row.result);
    ViStatus code = 0;
    EXPECT_EQ(errorText(&code), expectedText);
    EXPECT_EQ(code, row.result);
  }

  wrapper().clearErrorInfo(1);
  Status ok;
  EXPECT_EQ(converter().finishCall(wrapper(), ok, CallError{}, 0, kSecondaryErrorCallFrame), 0);
  Status localWarning(0x3FFA0002);
  EXPECT_EQ(
      converter().finishCall(wrapper(), localWarning, CallError{}, 0, kSecondaryErrorCallFrame), 0)
      << "a local warning is not reported";
  ViStatus code = -1;
  errorText(&code);
  EXPECT_EQ(code, 0) << "success leaves the error information untouched";
}

TEST_F(WithSession, FetchFamilyErrorComposesThreeParts) {
  const int32_t primary = static_cast<int32_t>(0xBFFA9157);
  wrapper().setErrorInfo(VI_TRUE, primary, kSecondaryErrorFetch, "server says no");
  EXPECT_EQ(errorText(),
            text(primary) + "\n\n" + text(kSecondaryErrorFetch) + "\n\nserver says no");
}

TEST_F(WithSession, ParameterPositionSecondaryIsLeftOut) {
  const int32_t primary = static_cast<int32_t>(0xBFFA0058);
  const ViStatus position = wrapper().paramPositionError(3, 1);
  wrapper().setErrorInfo(VI_TRUE, primary, position, "wfm");
  EXPECT_EQ(errorText(), text(primary) + "\n\nwfm");
}

TEST_F(WithSession, EmptyErrorInformation) {
  wrapper().clearErrorInfo(1);
  ViStatus code = -1;
  std::string zero = converter().render(Status(), 0);
  EXPECT_EQ(errorText(&code), zero.empty() ? "" : zero + "\n\n");
  EXPECT_EQ(code, 0);
}

TEST_F(WithSession, ToReplyStatusPrefersTheSessionsOwnText) {
  const int32_t driverError = -1074001111;
  Status driver;
  driver.set(driverError);
  int32_t code = 0;
  std::string reply;

  wrapper().setErrorInfo(VI_TRUE, driverError, 0, "channel 9 does not exist");
  converter().toReplyStatus(wrapper(), driver, code, reply, true, 0, kSecondaryErrorCallFrame);
  EXPECT_EQ(code, driverError);
  EXPECT_NE(reply.find("channel 9 does not exist"), std::string::npos);
  ViStatus left = -1;
  errorText(&left);
  EXPECT_EQ(left, 0) << "the session's error is taken and cleared";

  wrapper().setErrorInfo(VI_TRUE, -1074002222, 0, "another error");
  converter().toReplyStatus(wrapper(), driver, code, reply, true, 0, kSecondaryErrorCallFrame);
  EXPECT_EQ(code, driverError);
  std::string translated;
  Status result;
  converter().translateStatus(driver, 0, translated, result);
  EXPECT_EQ(reply, translated) << "a different pending error: the translated driver status";

  converter().toReplyStatus(wrapper(), Status(), code, reply, true, 0, kSecondaryErrorCallFrame);
  EXPECT_EQ(code, 0);
  EXPECT_EQ(reply, "");
}

TEST_F(WithSession, ErrorCacherSavesClearsAndRestores) {
  wrapper().setErrorInfo(VI_TRUE, -1074003333, 0x3FFA0001, "pending");
  ErrorCacher cacher;
  Status status;
  cacher.cacheAndClear(wrapper(), status);
  EXPECT_TRUE(cacher.isError());
  EXPECT_EQ(cacher.primaryError, -1074003333);
  EXPECT_EQ(cacher.secondaryError, 0x3FFA0001);
  EXPECT_EQ(cacher.elaboration, "pending");
  ViStatus code = -1;
  errorText(&code);
  EXPECT_EQ(code, 0) << "cleared in the session";

  cacher.restore(wrapper());
  EXPECT_EQ(errorText(&code), text(-1074003333) + "\n\n" + text(0x3FFA0001) + "\n\npending");
  EXPECT_EQ(code, -1074003333);

  ErrorCacher peek;
  peek.cache(wrapper(), status);
  EXPECT_EQ(peek.primaryError, -1074003333);
  errorText(&code);
  EXPECT_EQ(code, -1074003333) << "cache leaves the session's error in place";

  ErrorCacher refused;
  Status failed(-52003);
  EXPECT_THROW(refused.cacheAndClear(wrapper(), failed), HostErrorException);
  wrapper().clearErrorInfo(1);
  ErrorCacher empty;
  empty.cacheAndClear(wrapper(), status);
  EXPECT_TRUE(empty.isSuccess());
  empty.restore(wrapper());
  errorText(&code);
  EXPECT_EQ(code, 0) << "nothing saved, nothing restored";
}

}  // namespace
}  // namespace hsdig
