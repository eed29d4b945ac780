// The generated service against the contract's method list: count, order,
// and the shape facts that the dispatcher and the client exports rely on.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "hsdigEP_methods.h"

namespace hsdig {
namespace {

// The contract's methods in declaration order.
const std::vector<std::string> kDeclared = {"pingServer",
                                            "registerClientSession",
                                            "unregisterClientSession",
                                            "getStartTimestampInformation",
                                            "commit",
                                            "saveAttributes",
                                            "getAttributeWithOptionsViInt64",
                                            "addWaveformProcessing",
                                            "resetDevice",
                                            "importAttributeConfigurationBuffer",
                                            "autoSetup",
                                            "reset",
                                            "getAttributeViReal64",
                                            "actualMeasWfmSize",
                                            "getAttributeViInt32",
                                            "checkAttributeViInt32",
                                            "checkAttributeViBoolean",
                                            "checkAttributeViReal64",
                                            "readMeasurement",
                                            "fetchMeasurement",
                                            "getAttributeWithOptionsViReal64",
                                            "exportAttributeConfigurationBuffer",
                                            "getStreamEndpointHandle",
                                            "sampleRate",
                                            "configureVertical",
                                            "configureAcquisition",
                                            "readRegister",
                                            "setAttributeViSession",
                                            "resetAllAttributes",
                                            "fetchMeasurementStats",
                                            "setAttributeViInt64",
                                            "configureEqualizationFilterCoefficients",
                                            "configureTriggerWidth",
                                            "configureTriggerWindow",
                                            "requestPrivilege",
                                            "resetAttribute",
                                            "actualRecordLength",
                                            "importAttributes",
                                            "restoreAttributes",
                                            "setAttributeViString",
                                            "initiateAcquisition",
                                            "clearWaveformMeasurementStats",
                                            "disable",
                                            "setAttributeViBoolean",
                                            "checkAttributeViSession",
                                            "importAttributeConfigurationFile",
                                            "getAttributeFlags",
                                            "getAttributeWithOptionsViString",
                                            "getAttributeWithOptionsViSession",
                                            "checkAttributeViInt64",
                                            "clearWaveformProcessing",
                                            "getAttributeViInt64",
                                            "exportAttributeConfigurationFile",
                                            "configureChanCharacteristics",
                                            "actualNumWfms",
                                            "calSelfCalibrate",
                                            "parseNumberOfChannels",
                                            "writeRegister",
                                            "getAttributeWithOptionsViInt32",
                                            "getAttributeWithOptionsViBoolean",
                                            "acquisitionStatus",
                                            "adjustSampleClockRelativeDelay",
                                            "cableSenseSignalStop",
                                            "configureTriggerSoftware",
                                            "configureClock",
                                            "probeCompensationSignalStart",
                                            "exportSignal",
                                            "configureTriggerEdge",
                                            "sendSoftwareTriggerEdge",
                                            "configureTriggerRunt",
                                            "configureTriggerGlitch",
                                            "configureTriggerVideo",
                                            "setAttributeViReal64",
                                            "getAttributeViBoolean",
                                            "cableSenseSignalStart",
                                            "checkAttributeViString",
                                            "getFrequencyResponse",
                                            "getChannelNameFromString",
                                            "attributeWasSetByUser",
                                            "configureTriggerDigital",
                                            "setAttributeViInt32",
                                            "getAttributeViSession",
                                            "exportAttributes",
                                            "abort",
                                            "uncommit",
                                            "sampleMode",
                                            "getAttributeViString",
                                            "getSessionState",
                                            "configureHorizontalTiming",
                                            "configureTriggerImmediate",
                                            "configureTriggerHysteresis",
                                            "probeCompensationSignalStop",
                                            "getEqualizationFilterCoefficients",
                                            "getScalingOrNormalizationCoefficients",
                                            "revision_query",
                                            "self_test",
                                            "fetchArrayMeasurement",
                                            "omniReadOrFetch"};

TEST(MethodTable, HasTheDeclaredMethodsInOrder) {
  ASSERT_EQ(kDeclared.size(), 98u);
  ASSERT_EQ(methods::kCount, 98);
  for (size_t i = 0; i < kDeclared.size(); ++i) {
    SCOPED_TRACE(kDeclared[i]);
    EXPECT_EQ(methods::kWireNames[i], kDeclared[i]);
  }
}

TEST(MethodTable, TraitsMatchTheirPlaceInTheList) {
  std::vector<std::string> expanded;
#define HSDIG_CHECK_METHOD(position, name)                \
  EXPECT_EQ(methods::name::index, position);              \
  EXPECT_EQ(std::string(methods::name::wireName), #name); \
  expanded.push_back(#name);
  HSDIG_EP_METHODS(HSDIG_CHECK_METHOD)
#undef HSDIG_CHECK_METHOD
  EXPECT_EQ(expanded, kDeclared);
}

TEST(MethodTable, ShapeFactsOfTheSpecialMethods) {
  EXPECT_FALSE(methods::pingServer::hasResult);
  EXPECT_EQ(methods::pingServer::argumentCount, 0);
  EXPECT_TRUE(methods::registerClientSession::hasResult);
  EXPECT_FALSE(methods::registerClientSession::hasNulls);
  EXPECT_TRUE(methods::configureVertical::hasNulls);
  EXPECT_EQ(methods::configureVertical::argumentCount, 8);
  // The waveform, coefficient, revision and self-test methods name the session
  // clientID and carry no null flags.
  EXPECT_FALSE(methods::getScalingOrNormalizationCoefficients::hasNulls);
  EXPECT_FALSE(methods::revision_query::hasNulls);
  EXPECT_FALSE(methods::self_test::hasNulls);
  EXPECT_FALSE(methods::fetchArrayMeasurement::hasNulls);
  EXPECT_FALSE(methods::omniReadOrFetch::hasNulls);
  EXPECT_TRUE((std::is_same_v<methods::omniReadOrFetch::Success, RetWfmRecords>));
  EXPECT_TRUE((std::is_same_v<methods::abort::Success, RetStatus>));
  // The second field of omniReadOrFetch is spelled channeList.
  methods::omniReadOrFetch::Args args;
  args.channeList = "0";
  EXPECT_TRUE((std::is_same_v<decltype(args.channeList), std::string>));
}

}  // namespace
}  // namespace hsdig
