// RemoteErrorConverter: the one place where failures become statuses.
//
// Three kinds of failure meet here:
// - a failure inside this library, held in a Status (no client for the
//   session, a transport or protocol failure, memory exhaustion, ...);
// - an error or warning the server reported in a reply, held in a CallError;
// - on the server side, the status of the real driver call, which becomes
//   the code and text of the reply.
// The client's exports end in finishCall, the server's handlers in
// toReplyStatus; both leave the text where the driver's own error functions
// find it (the session's IVI error information) or in the reply.
//
// Stateless; one process-wide instance, created on first use
// (remoteErrorConverter()). Any thread may call any operation.
#pragma once

#include <string>

#include <thrift/Thrift.h>

#include "errors/Status.h"
#include "errors/conversion/CallError.h"
#include "session/IviWrapperInterface.h"

namespace hsdig {

class RemoteErrorConverterInterface {
 public:
  virtual ~RemoteErrorConverterInterface() = default;

  // Inside a catch handler: turns the exception being handled into `status`
  // (Thrift exceptions by their kind, std::length_error -52003,
  // std::bad_alloc -52000, the library's own by their status, any other
  // standard exception -52003). Exceptions outside the standard hierarchy
  // are rethrown.
  virtual void convertCurrentException(Status& status) = 0;
  // Server handlers: a HostErrorException sets `isHostError` and nothing
  // else; anything else is converted.
  virtual void classifyCurrentException(Status& status, bool& isHostError) = 0;
  // Client exports: a HostErrorException becomes the call's error (its text
  // only when no local error is held); anything else is converted.
  virtual void captureCurrentException(Status& status, CallError& callError) = 0;
  // The last step of every client export: stores the failure in the
  // session's error information and returns the export's status.
  virtual ViStatus finishCall(IviWrapperInterface& wrapper, Status& status,
                              const CallError& callError, uint32_t language,
                              ViStatus secondaryCode) = 0;
  // Server handlers: the reply's code and text for the driver's status.
  virtual void toReplyStatus(IviWrapperInterface& wrapper, const Status& driverStatus,
                             int32_t& code, std::string& text, bool useSessionError,
                             uint32_t language, ViStatus secondaryCode) = 0;
  // The text of a non-zero status in `language`; a zero status leaves `text`
  // as it is. Failures of the translation go to `result`.
  virtual void translateStatus(const Status& status, uint32_t language, std::string& text,
                               Status& result) = 0;
  // The body of hsdigRemote_GetError (see the exports).
  virtual ViStatus getErrorText(IviWrapperInterface& wrapper, ViStatus* errorCode,
                                ViInt32 bufferSize, ViChar* buffer, uint32_t language,
                                ViStatus secondaryCode) = 0;
  // Sets the code for a Thrift exception; false (and -52003) when the
  // conversion itself failed.
  virtual bool convertThriftException(const apache::thrift::TException& exception,
                                      Status& status) = 0;
};

class RemoteErrorConverter : public RemoteErrorConverterInterface {
 public:
  void convertCurrentException(Status& status) override;
  void classifyCurrentException(Status& status, bool& isHostError) override;
  void captureCurrentException(Status& status, CallError& callError) override;
  ViStatus finishCall(IviWrapperInterface& wrapper, Status& status, const CallError& callError,
                      uint32_t language, ViStatus secondaryCode) override;
  void toReplyStatus(IviWrapperInterface& wrapper, const Status& driverStatus, int32_t& code,
                     std::string& text, bool useSessionError, uint32_t language,
                     ViStatus secondaryCode) override;
  void translateStatus(const Status& status, uint32_t language, std::string& text,
                       Status& result) override;
  ViStatus getErrorText(IviWrapperInterface& wrapper, ViStatus* errorCode, ViInt32 bufferSize,
                        ViChar* buffer, uint32_t language, ViStatus secondaryCode) override;
  bool convertThriftException(const apache::thrift::TException& exception, Status& status) override;

  // The translator's text of `status`, also for code 0. Throws what the
  // translation throws; a translation without text throws Exception.
  static std::string render(const Status& status, uint32_t language);
};

RemoteErrorConverterInterface& remoteErrorConverter();

// The translator's forward code mapping: infrastructure codes into the
// driver's range; every other code unchanged.
int32_t mapStatusCode(int32_t code) noexcept;

// The session's pending error information.
inline constexpr ViAttr kAttrPrimaryError = 1050101;
inline constexpr ViAttr kAttrSecondaryError = 1050102;
inline constexpr ViAttr kAttrErrorElaboration = 1050103;

}  // namespace hsdig
