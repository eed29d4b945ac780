// OptionStringInformation: what the IVI engine makes of a resource name and
// an option string: the resolved resource name (UTF-8), the resolved option
// string, whether the name was a logical name, whether the session would be
// simulated, and the driver-setup text (at most 255 characters).
//
// Construction asks the engine to resolve the name, then opens a temporary
// engine session with the driver prefix "hsdig" to read the simulation flag
// and the driver setup, and disposes it again (also when a read fails).
// Failures throw Exception with the engine's status.
#pragma once

#include <string>

#include "session/IviWrapper.h"

namespace hsdig {

class OptionStringInformationInterface {
 public:
  virtual ~OptionStringInformationInterface() = default;
  virtual std::string getResourceName() const = 0;
  virtual std::string getOptionString() const = 0;
  virtual bool isLogicalName() const = 0;
  virtual bool isSimulated() const = 0;
  virtual std::string getDriverSetup() const = 0;
};

class OptionStringInformation : public OptionStringInformationInterface {
 public:
  static constexpr size_t kBufferSize = 256;

  OptionStringInformation(const std::string& resourceName, const std::string& optionString,
                          const IviWrapperFactory& factory = IviWrapperFactory());

  std::string getResourceName() const override { return resourceName_; }
  std::string getOptionString() const override { return optionString_; }
  bool isLogicalName() const override { return logicalName_; }
  bool isSimulated() const override { return simulated_; }
  std::string getDriverSetup() const override { return driverSetup_; }

 private:
  std::string resourceName_;
  std::string optionString_;
  bool logicalName_ = false;
  bool simulated_ = false;
  char driverSetup_[kBufferSize] = {};
};

}  // namespace hsdig
