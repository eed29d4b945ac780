// The error exports: the text of a session's pending error, the text of any
// status code, and clearing the pending error. The host-environment twins
// forward unchanged.
#include <cstring>
#include <string>

#include "errors/ErrorDescription.h"
#include "errors/conversion/RemoteErrorConverter.h"
#include "hsdigRemote/hsdigRemote.h"
#include "session/IviWrapper.h"
#include "session/LanguageAccessor.h"

using namespace hsdig;

namespace {

uint32_t languageOf(IviWrapperInterface& wrapper) {
  try {
    return languageAccessor().getLanguage(wrapper);
  } catch (...) {
    return 0;
  }
}

}  // namespace

extern "C" {

HSDIGREMOTE_API ViStatus hsdigRemote_GetError(ViSession vi, ViStatus* errorCode, ViInt32 bufferSize,
                                              ViChar description[]) {
  try {
    IviWrapper wrapper(vi);
    return remoteErrorConverter().getErrorText(wrapper, errorCode, bufferSize, description,
                                               languageOf(wrapper), kSecondaryErrorCallFrame);
  } catch (...) {
    return mapStatusCode(kErrorInternal);
  }
}

HSDIGREMOTE_API ViStatus hsdigRemote_GetErrorMessage(ViSession vi, ViStatus errorCode,
                                                     ViInt32 bufferSize, ViChar message[]) {
  if (bufferSize < 0) return kErrorInvalidParameter;
  if (bufferSize > 0 && message == nullptr) return kErrorNullPointer;
  try {
    IviWrapper wrapper(vi);
    const uint32_t language = languageOf(wrapper);
    Status status;
    if (errorCode != 0) {
      status.set(errorCode);
      if (!description::hasOrderedData(status)) description::prepare(status);
    }
    std::string text;
    Status result;
    // The text of code 0 is the translator's too, so the converter's
    // renderer is asked directly rather than translateStatus, which leaves
    // a zero status without text.
    try {
      text = RemoteErrorConverter::render(status, language);
    } catch (...) {
      remoteErrorConverter().convertCurrentException(result);
    }
    if (result.code() < 0) return mapStatusCode(result.code());
    if (bufferSize == 0) return static_cast<ViStatus>(text.size());
    // At most bufferSize bytes, zero-filled after a shorter text; no
    // terminator when the text fills the buffer.
    const size_t copied = std::min(text.size(), static_cast<size_t>(bufferSize));
    std::memcpy(message, text.data(), copied);
    std::memset(message + copied, 0, static_cast<size_t>(bufferSize) - copied);
    return result.code();
  } catch (...) {
    return mapStatusCode(kErrorInternal);
  }
}

HSDIGREMOTE_API ViStatus hsdigRemote_ClearError(ViSession vi) {
  try {
    IviWrapper wrapper(vi);
    return wrapper.clearErrorInfo(1);
  } catch (...) {
    return mapStatusCode(kErrorInternal);
  }
}

HSDIGREMOTE_API ViStatus hsdigRemote_QLGetError(ViSession vi, ViStatus* errorCode,
                                                ViInt32 bufferSize, ViChar description[]) {
  return hsdigRemote_GetError(vi, errorCode, bufferSize, description);
}

HSDIGREMOTE_API ViStatus hsdigRemote_QLGetErrorMessage(ViSession vi, ViStatus errorCode,
                                                       ViInt32 bufferSize, ViChar message[]) {
  return hsdigRemote_GetErrorMessage(vi, errorCode, bufferSize, message);
}

}  // extern "C"
