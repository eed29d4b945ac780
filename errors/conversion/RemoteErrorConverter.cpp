#include "errors/conversion/RemoteErrorConverter.h"

#include <thrift/protocol/TProtocolException.h>
#include <thrift/transport/TTransportException.h>

#include <new>
#include <stdexcept>
#include <vector>

#include "errors/ErrorDescription.h"
#include "errors/Exception.h"
#include "errors/conversion/CopyStringOut.h"
#include "errors/translator/CodeMapping.h"
#include "errors/translator/TranslatorSession.h"
#include "session/SessionLock.h"

namespace hsdig {

namespace {

using apache::thrift::protocol::TProtocolException;
using apache::thrift::transport::TTransportException;

int32_t protocolCode(int type) {
  switch (type) {
    case TProtocolException::INVALID_DATA:
      return static_cast<int32_t>(0xBFFA9150);
    case TProtocolException::NEGATIVE_SIZE:
      return static_cast<int32_t>(0xBFFA9151);
    case TProtocolException::SIZE_LIMIT:
      return static_cast<int32_t>(0xBFFA9152);
    case TProtocolException::BAD_VERSION:
      return static_cast<int32_t>(0xBFFA9153);
    case TProtocolException::NOT_IMPLEMENTED:
      return static_cast<int32_t>(0xBFFA9154);
    default:
      return static_cast<int32_t>(0xBFFA914F);
  }
}

int32_t transportCode(int type) {
  switch (type) {
    case TTransportException::NOT_OPEN:
      return static_cast<int32_t>(0xBFFA9156);
    case TTransportException::TIMED_OUT:
      return static_cast<int32_t>(0xBFFA9157);
    case TTransportException::END_OF_FILE:
      return static_cast<int32_t>(0xBFFA9158);
    case TTransportException::INTERRUPTED:
      return static_cast<int32_t>(0xBFFA9159);
    case TTransportException::BAD_ARGS:
      return static_cast<int32_t>(0xBFFA915A);
    case TTransportException::CORRUPTED_DATA:
      return static_cast<int32_t>(0xBFFA915B);
    case TTransportException::INTERNAL_ERROR:
      return static_cast<int32_t>(0xBFFA915C);
    default:
      return static_cast<int32_t>(0xBFFA9155);
  }
}

constexpr int32_t kOtherThriftException = static_cast<int32_t>(0xBFFA914E);

// The text of a failure of this layer itself when not even the translator
// can describe it.
const char* lastResortText(int32_t code) {
  return code == kErrorOutOfMemory ? "Out of memory." : "Internal error.";
}

}  // namespace

int32_t mapStatusCode(int32_t code) noexcept {
  return translator::cvmxl_mapErrorCode(code);
}

RemoteErrorConverterInterface& remoteErrorConverter() {
  static RemoteErrorConverter instance;
  return instance;
}

void RemoteErrorConverter::convertCurrentException(Status& status) {
  try {
    throw;
  } catch (const apache::thrift::TException& e) {
    convertThriftException(e, status);
  } catch (const std::length_error&) {
    status.set(kErrorInternal);
  } catch (const std::bad_alloc&) {
    status.set(kErrorOutOfMemory);
  } catch (const ExceptionBase& e) {
    if (Status::replaces(status.code(), e.status().code())) status = e.status();
  } catch (const std::exception&) {
    status.set(kErrorInternal);
  }
}

bool RemoteErrorConverter::convertThriftException(const apache::thrift::TException& exception,
                                                  Status& status) {
  try {
    if (const auto* p = dynamic_cast<const TProtocolException*>(&exception)) {
      status.set(protocolCode(p->getType()));
    } else if (const auto* t = dynamic_cast<const TTransportException*>(&exception)) {
      status.set(transportCode(t->getType()));
    } else {
      status.set(kOtherThriftException);
    }
    return true;
  } catch (...) {
    status.set(kErrorInternal);
    return false;
  }
}

void RemoteErrorConverter::captureCurrentException(Status& status, CallError& callError) {
  try {
    throw;
  } catch (const HostErrorException& e) {
    callError.code = e.code();
    if (status.code() >= 0) callError.text = e.text();
  } catch (const std::exception&) {
    convertCurrentException(status);
  }
}

void RemoteErrorConverter::classifyCurrentException(Status& status, bool& isHostError) {
  try {
    throw;
  } catch (const HostErrorException&) {
    isHostError = true;
  } catch (const std::exception&) {
    convertCurrentException(status);
  }
}

std::string RemoteErrorConverter::render(const Status& status, uint32_t language) {
  std::string text;
  Status result;
  translator::TranslatorSession session;
  session.translate(status, static_cast<int>(language), translator::kConversionFlags, text, result);
  if (result.isError()) throw Exception(result);
  return text;
}

void RemoteErrorConverter::translateStatus(const Status& status, uint32_t language,
                                           std::string& text, Status& result) {
  if (status.code() == 0) return;
  text.clear();
  try {
    text = render(status, language);
  } catch (const std::bad_alloc&) {
    result.set(kErrorOutOfMemory);
  } catch (const ExceptionBase& e) {
    result.set(e.status().code());
  } catch (const std::exception&) {
    result.set(kErrorInternal);
  }
}

ViStatus RemoteErrorConverter::finishCall(IviWrapperInterface& wrapper, Status& status,
                                          const CallError& callError, uint32_t language,
                                          ViStatus secondaryCode) {
  try {
    if (status.code() >= 0) {
      // A local warning is not reported; the server's outcome is.
      if (callError.code == 0) return 0;
      wrapper.setErrorInfo(VI_TRUE, callError.code, secondaryCode, callError.text.c_str());
      return callError.code;
    }
    std::string text;
    Status failure;
    translateStatus(status, language, text, failure);
    if (failure.isError()) throw Exception(failure);
    const int32_t code = mapStatusCode(status.code());
    status.renumber(code);
    wrapper.setErrorInfo(VI_TRUE, code, secondaryCode, text.c_str());
    return code;
  } catch (...) {
    try {
      wrapper.setErrorInfo(VI_TRUE, kErrorInternal, 0, "", /*noThrow=*/1);
    } catch (...) {
      // The engine is gone; the status below is all that is left to give.
    }
    return kErrorInternal;
  }
}

void RemoteErrorConverter::toReplyStatus(IviWrapperInterface& wrapper, const Status& driverStatus,
                                         int32_t& code, std::string& text, bool useSessionError,
                                         uint32_t language, ViStatus secondaryCode) {
  auto failWith = [&](int32_t failure) {
    code = failure;
    text.clear();
    try {
      text = render(Status(failure), language);
    } catch (...) {
      text = lastResortText(failure);
    }
  };
  try {
    if (driverStatus.code() == 0) {
      code = 0;
      text.clear();
      return;
    }
    if (useSessionError && wrapper.getSessionHandle() != 0) {
      ViStatus primary = 0;
      const ViStatus needed = getErrorText(wrapper, &primary, 0, nullptr, language, secondaryCode);
      if (needed >= 1 && primary == driverStatus.code()) {
        std::vector<ViChar> buffer(static_cast<size_t>(needed));
        getErrorText(wrapper, &primary, needed, buffer.data(), language, secondaryCode);
        text.assign(buffer.data());
        wrapper.clearErrorInfo();
        code = primary;
        return;
      }
    }
    Status failure;
    translateStatus(driverStatus, language, text, failure);
    if (failure.isError()) throw Exception(failure);
    code = driverStatus.code();
  } catch (const std::bad_alloc&) {
    failWith(kErrorOutOfMemory);
  } catch (...) {
    failWith(kErrorInternal);
  }
}

ViStatus RemoteErrorConverter::getErrorText(IviWrapperInterface& wrapper, ViStatus* errorCode,
                                            ViInt32 bufferSize, ViChar* buffer, uint32_t language,
                                            ViStatus secondaryCode) {
  ViStatus result = 0;
  try {
    // The three attributes are read under the session lock, so that a
    // concurrent finishCall cannot interleave between them.
    SessionLock lock;
    if (wrapper.getSessionHandle() != 0) lock.lock(wrapper);

    ViInt32 primary = 0, secondary = 0;
    ViStatus read = wrapper.getAttributeViInt32("", kAttrPrimaryError, 0, &primary, 1);
    if (read < 0) return mapStatusCode(read);
    read = wrapper.getAttributeViInt32("", kAttrSecondaryError, 0, &secondary, 1);
    if (read < 0) return mapStatusCode(read);
    const ViInt32 size = wrapper.getAttributeViString("", kAttrErrorElaboration, 0, 0, nullptr, 1);
    if (size < 0) return mapStatusCode(size);
    std::vector<ViChar> elaborationBuffer(static_cast<size_t>(size) + 1, '\0');
    if (size > 0) {
      read = wrapper.getAttributeViString("", kAttrErrorElaboration, 0, size,
                                          elaborationBuffer.data(), 1);
      if (read < 0) return mapStatusCode(read);
    }
    const std::string elaboration(elaborationBuffer.data());

    std::string description;
    if (secondary == secondaryCode) {
      // The session holds a server text that finishCall put there.
      description = elaboration;
    } else {
      Status primaryStatus;
      primaryStatus.set(primary);
      description::prepare(primaryStatus);
      description = render(primaryStatus, language);
      bool positionCode = false;
      for (ViInt32 position = 1; position <= 9 && !positionCode; ++position) {
        positionCode = secondary == wrapper.paramPositionError(position, 1);
      }
      if (secondary != 0 && !positionCode) {
        description += "\n\n";
        description += render(Status(secondary), language);
      }
      if (!description.empty()) description += "\n\n";
      description += elaboration;
    }
    if (errorCode != nullptr) *errorCode = primary;
    result = copyStringOut(description, bufferSize, buffer);
  } catch (...) {
    Status failure;
    try {
      convertCurrentException(failure);
    } catch (...) {
      failure.set(kErrorInternal);
    }
    result = failure.isError() ? failure.code() : kErrorInternal;
  }
  // Only failures are moved into the driver's range: a positive result is
  // the size the caller needs, and sizes that happen to lie in a mapped
  // warning range must stay sizes.
  return result < 0 ? mapStatusCode(result) : result;
}

}  // namespace hsdig
