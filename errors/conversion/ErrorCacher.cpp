#include "errors/conversion/ErrorCacher.h"

#include <vector>

#include "errors/Exception.h"
#include "errors/conversion/RemoteErrorConverter.h"

namespace hsdig {

namespace {

void throwIfStatusIsError(const Status& status) {
  if (status.isError()) throw HostErrorException(status.code(), "");
}

void setIfNonZero(Status& status, ViStatus read) {
  if (read != 0) status.set(read);
}

}  // namespace

void ErrorCacher::read(IviWrapperInterface& wrapper, Status& status, bool clear) {
  throwIfStatusIsError(status);
  ViInt32 primary = 0;
  setIfNonZero(status, wrapper.getAttributeViInt32("", kAttrPrimaryError, 0, &primary, 1));
  if (primary == 0) return;

  ViInt32 secondary = 0;
  setIfNonZero(status, wrapper.getAttributeViInt32("", kAttrSecondaryError, 0, &secondary, 1));
  throwIfStatusIsError(status);
  const ViInt32 size = wrapper.getAttributeViString("", kAttrErrorElaboration, 0, 0, nullptr, 1);
  if (size < 0) throw HostErrorException(size, "");
  std::vector<ViChar> text(static_cast<size_t>(size) + 1, '\0');
  if (size > 0) {
    const ViStatus read =
        wrapper.getAttributeViString("", kAttrErrorElaboration, 0, size, text.data(), 1);
    if (read < 0) status.set(read);
  }
  if (clear) setIfNonZero(status, wrapper.clearErrorInfo(1));
  throwIfStatusIsError(status);
  primaryError = primary;
  secondaryError = secondary;
  elaboration.assign(text.data());
}

void ErrorCacher::restore(IviWrapperInterface& wrapper) {
  if (primaryError == 0) return;
  wrapper.setErrorInfo(VI_TRUE, primaryError, secondaryError, elaboration.c_str());
}

}  // namespace hsdig
