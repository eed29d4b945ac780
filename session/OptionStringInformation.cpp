#include "session/OptionStringInformation.h"

#include <cstring>

#include "session/AnsiText.h"

namespace hsdig {

OptionStringInformation::OptionStringInformation(const std::string& resourceName,
                                                 const std::string& optionString,
                                                 const IviWrapperFactory& factory) {
  char options[kBufferSize] = {};
  std::memcpy(options, optionString.data(), std::min(optionString.size(), kBufferSize - 1));
  char newResourceName[kBufferSize] = {};
  char newOptionString[kBufferSize] = {};
  ViBoolean logicalName = VI_FALSE;

  auto noSession = factory.create(0);
  noSession->getInfoFromResourceName(resourceName.c_str(), options, newResourceName,
                                     newOptionString, &logicalName);
  newResourceName[kBufferSize - 1] = '\0';
  newOptionString[kBufferSize - 1] = '\0';
  resourceName_ = ansiToUtf8(newResourceName);
  optionString_ = newOptionString;
  logicalName_ = logicalName == 1;

  ViSession temporary = 0;
  noSession->specificDriverNew("hsdig", newOptionString, &temporary);
  auto session = factory.create(temporary);
  // The temporary session goes whatever happens while it is read.
  struct Dispose {
    IviWrapperInterface& session;
    ~Dispose() { session.dispose(1); }
  } dispose{*session};
  simulated_ = session->simulating() == 1;
  session->getAttributeViString("", IVI_ATTR_DRIVER_SETUP, 0, kBufferSize, driverSetup_);
  driverSetup_[kBufferSize - 1] = '\0';
}

}  // namespace hsdig
