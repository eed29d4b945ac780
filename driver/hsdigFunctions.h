/* The one table of the driver functions that the remoting server calls.
 *
 * HSDIG_DRIVER_FUNCTIONS(X) expands X(Name, (parameters), (argument names))
 * once per function; the C name is hsdig_<Name>. Every function takes the
 * driver session first and returns a ViStatus (0 success, negative error,
 * positive warning). The table drives the declarations in hsdig.h, the
 * simulated digitizer's exported bodies and the tests that check the exports,
 * so a function is added or changed here and nowhere else.
 *
 * Calling conventions the server relies on:
 * - Input strings may be NULL where a caller may pass a null pointer; the
 *   driver then answers HSDIG_ERROR_NULL_POINTER unless the function
 *   documents a meaning for NULL (a NULL channel list of the attribute
 *   functions means "no channel", like "").
 * - Scalar outputs may be NULL; the driver then skips that output.
 * - String outputs come as (bufferSize, buffer): size 0 returns the size
 *   needed (terminator included) and writes nothing; a smaller buffer gets a
 *   truncated, terminated text and the call returns the size needed; a large
 *   enough buffer gets the whole text and the call returns 0.
 * - Arrays take the caller's element count and are never written past it.
 * - The waveform functions take (session, channel list, timeout in seconds,
 *   samples per record, sample buffer, timing array): waveform i of the
 *   channel list (channel-major, then record) starts at element
 *   i x numSamples of the sample buffer and fills timing entry i. The buffer
 *   holds ActualNumWfms x numSamples samples; numSamples -1 means the record
 *   length. Complex formats count one (real, imaginary) pair as a sample. */
#ifndef HSDIG_FUNCTIONS_H
#define HSDIG_FUNCTIONS_H

/* clang-format off */
#define HSDIG_DRIVER_FUNCTIONS(X) \
  /* Actions */ \
  X(Abort, (ViSession vi), (vi)) \
  X(AutoSetup, (ViSession vi), (vi)) \
  X(Commit, (ViSession vi), (vi)) \
  X(Uncommit, (ViSession vi), (vi)) \
  X(Disable, (ViSession vi), (vi)) \
  X(InitiateAcquisition, (ViSession vi), (vi)) \
  X(reset, (ViSession vi), (vi)) \
  X(ResetDevice, (ViSession vi), (vi)) \
  X(ResetAllAttributes, (ViSession vi), (vi)) \
  X(SaveAttributes, (ViSession vi), (vi)) \
  X(RestoreAttributes, (ViSession vi), (vi)) \
  X(ExportAttributes, (ViSession vi), (vi)) \
  X(ImportAttributes, (ViSession vi), (vi)) \
  X(RequestPrivilege, (ViSession vi, ViInt32 privilegeLevel), (vi, privilegeLevel)) \
  X(ProbeCompensationSignalStart, (ViSession vi), (vi)) \
  X(ProbeCompensationSignalStop, (ViSession vi), (vi)) \
  X(CableSenseSignalStart, (ViSession vi), (vi)) \
  X(CableSenseSignalStop, (ViSession vi), (vi)) \
  /* Configuration */ \
  X(ConfigureVertical, (ViSession vi, ViConstString channelList, ViReal64 range, ViReal64 offset, ViInt32 coupling, ViReal64 probeAttenuation, ViBoolean enabled), (vi, channelList, range, offset, coupling, probeAttenuation, enabled)) \
  X(ConfigureChanCharacteristics, (ViSession vi, ViConstString channelList, ViReal64 inputImpedance, ViReal64 maxInputFrequency), (vi, channelList, inputImpedance, maxInputFrequency)) \
  X(ConfigureHorizontalTiming, (ViSession vi, ViReal64 minSampleRate, ViInt32 minNumPts, ViReal64 refPosition, ViInt32 numRecords, ViBoolean enforceRealtime), (vi, minSampleRate, minNumPts, refPosition, numRecords, enforceRealtime)) \
  X(ConfigureAcquisition, (ViSession vi, ViInt32 acquisitionType), (vi, acquisitionType)) \
  X(ConfigureClock, (ViSession vi, ViConstString inputClockSource, ViConstString outputClockSource, ViConstString clockSyncPulseSource, ViBoolean masterEnabled), (vi, inputClockSource, outputClockSource, clockSyncPulseSource, masterEnabled)) \
  X(AdjustSampleClockRelativeDelay, (ViSession vi, ViReal64 delay), (vi, delay)) \
  X(ConfigureEqualizationFilterCoefficients, (ViSession vi, ViConstString channelList, ViInt32 numberOfCoefficients, const ViReal64 coefficients[]), (vi, channelList, numberOfCoefficients, coefficients)) \
  X(ConfigureTriggerEdge, (ViSession vi, ViConstString triggerSource, ViReal64 level, ViInt32 slope, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, level, slope, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerHysteresis, (ViSession vi, ViConstString triggerSource, ViReal64 level, ViReal64 hysteresis, ViInt32 slope, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, level, hysteresis, slope, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerWindow, (ViSession vi, ViConstString triggerSource, ViReal64 lowLevel, ViReal64 highLevel, ViInt32 windowMode, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, lowLevel, highLevel, windowMode, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerWidth, (ViSession vi, ViConstString triggerSource, ViReal64 level, ViReal64 lowThreshold, ViReal64 highThreshold, ViInt32 polarity, ViInt32 condition, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, level, lowThreshold, highThreshold, polarity, condition, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerRunt, (ViSession vi, ViConstString triggerSource, ViReal64 lowThreshold, ViReal64 highThreshold, ViInt32 polarity, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, lowThreshold, highThreshold, polarity, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerGlitch, (ViSession vi, ViConstString triggerSource, ViReal64 level, ViReal64 width, ViInt32 polarity, ViInt32 glitchCondition, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, level, width, polarity, glitchCondition, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerVideo, (ViSession vi, ViConstString triggerSource, ViBoolean enableDcRestore, ViInt32 signalFormat, ViInt32 event, ViInt32 lineNumber, ViInt32 polarity, ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, enableDcRestore, signalFormat, event, lineNumber, polarity, triggerCoupling, holdoff, delay)) \
  X(ConfigureTriggerDigital, (ViSession vi, ViConstString triggerSource, ViInt32 slope, ViReal64 holdoff, ViReal64 delay), (vi, triggerSource, slope, holdoff, delay)) \
  X(ConfigureTriggerSoftware, (ViSession vi, ViReal64 holdoff, ViReal64 delay), (vi, holdoff, delay)) \
  X(ConfigureTriggerImmediate, (ViSession vi), (vi)) \
  X(SendSoftwareTriggerEdge, (ViSession vi, ViInt32 whichTrigger), (vi, whichTrigger)) \
  X(ExportSignal, (ViSession vi, ViInt32 signal, ViConstString signalIdentifier, ViConstString outputTerminal), (vi, signal, signalIdentifier, outputTerminal)) \
  X(AddWaveformProcessing, (ViSession vi, ViConstString channelList, ViInt32 measFunction), (vi, channelList, measFunction)) \
  X(ClearWaveformProcessing, (ViSession vi, ViConstString channelList), (vi, channelList)) \
  X(CalSelfCalibrate, (ViSession vi, ViConstString channelList, ViInt32 option), (vi, channelList, option)) \
  X(WriteRegister, (ViSession vi, ViInt32 size, ViInt32 offset, ViInt32 value), (vi, size, offset, value)) \
  /* Attributes */ \
  HSDIG_ATTRIBUTE_ACCESS(X, ViInt32, ViInt32) \
  HSDIG_ATTRIBUTE_ACCESS(X, ViInt64, ViInt64) \
  HSDIG_ATTRIBUTE_ACCESS(X, ViReal64, ViReal64) \
  HSDIG_ATTRIBUTE_ACCESS(X, ViBoolean, ViBoolean) \
  HSDIG_ATTRIBUTE_ACCESS(X, ViSession, ViSession) \
  X(SetAttributeViString, (ViSession vi, ViConstString channelList, ViAttr attributeId, ViConstString value), (vi, channelList, attributeId, value)) \
  X(CheckAttributeViString, (ViSession vi, ViConstString channelList, ViAttr attributeId, ViConstString value), (vi, channelList, attributeId, value)) \
  X(GetAttributeViString, (ViSession vi, ViConstString channelList, ViAttr attributeId, ViInt32 bufSize, ViChar value[]), (vi, channelList, attributeId, bufSize, value)) \
  X(GetAttributeWithOptionsViString, (ViSession vi, ViConstString channelList, ViAttr attributeId, ViInt32 retrievalMode, ViInt32 bufSize, ViChar value[]), (vi, channelList, attributeId, retrievalMode, bufSize, value)) \
  X(ResetAttribute, (ViSession vi, ViConstString channelList, ViAttr attributeId), (vi, channelList, attributeId)) \
  X(AttributeWasSetByUser, (ViSession vi, ViConstString repCapName, ViAttr attributeId, ViBoolean* wasSetByUser), (vi, repCapName, attributeId, wasSetByUser)) \
  X(GetAttributeFlags, (ViSession vi, ViAttr attributeId, ViInt32* flags, ViBoolean* supported), (vi, attributeId, flags, supported)) \
  X(ExportAttributeConfigurationBuffer, (ViSession vi, ViInt32 sizeInBytes, ViInt8 configuration[]), (vi, sizeInBytes, configuration)) \
  X(ImportAttributeConfigurationBuffer, (ViSession vi, ViInt32 sizeInBytes, const ViInt8 configuration[]), (vi, sizeInBytes, configuration)) \
  X(ExportAttributeConfigurationFile, (ViSession vi, ViConstString filePath), (vi, filePath)) \
  X(ImportAttributeConfigurationFile, (ViSession vi, ViConstString filePath), (vi, filePath)) \
  /* Queries */ \
  X(ActualNumWfms, (ViSession vi, ViConstString channelList, ViInt32* numWfms), (vi, channelList, numWfms)) \
  X(ActualRecordLength, (ViSession vi, ViInt32* recordLength), (vi, recordLength)) \
  X(ActualMeasWfmSize, (ViSession vi, ViInt32 arrayMeasFunction, ViInt32* measWaveformSize), (vi, arrayMeasFunction, measWaveformSize)) \
  X(AcquisitionStatus, (ViSession vi, ViInt32* acquisitionStatus), (vi, acquisitionStatus)) \
  X(GetSessionState, (ViSession vi, ViConstString channelName, ViInt32* sessionState), (vi, channelName, sessionState)) \
  X(SampleRate, (ViSession vi, ViReal64* sampleRate), (vi, sampleRate)) \
  X(SampleMode, (ViSession vi, ViInt32* sampleMode), (vi, sampleMode)) \
  X(ParseNumberOfChannels, (ViSession vi, ViConstString channel, ViInt32* numChannels), (vi, channel, numChannels)) \
  X(GetChannelNameFromString, (ViSession vi, ViConstString index, ViInt32 bufferSize, ViChar name[]), (vi, index, bufferSize, name)) \
  X(GetStartTimestampInformation, (ViSession vi, ViInt32* sysTimeIn128BitsT1, ViInt32* sysTimeIn128BitsT2, ViInt32* sysTimeIn128BitsT3, ViInt32* sysTimeIn128BitsT4, ViReal64* deviceTimeInAbsoluteTimeUnits), (vi, sysTimeIn128BitsT1, sysTimeIn128BitsT2, sysTimeIn128BitsT3, sysTimeIn128BitsT4, deviceTimeInAbsoluteTimeUnits)) \
  X(GetStreamEndpointHandle, (ViSession vi, ViConstString streamName, ViInt32* writerHandle), (vi, streamName, writerHandle)) \
  X(GetEqualizationFilterCoefficients, (ViSession vi, ViConstString channel, ViInt32 numberOfCoefficients, ViReal64 coefficients[]), (vi, channel, numberOfCoefficients, coefficients)) \
  X(GetFrequencyResponse, (ViSession vi, ViConstString channel, ViInt32 bufferSize, ViReal64 frequencies[], ViReal64 amplitudes[], ViReal64 phases[], ViInt32* numberOfFrequencies), (vi, channel, bufferSize, frequencies, amplitudes, phases, numberOfFrequencies)) \
  X(GetScalingCoefficients, (ViSession vi, ViConstString channelList, ViInt32 bufferSize, hsdigCoefficientInfo coefficientInfo[], ViInt32* numberOfCoefficientSets), (vi, channelList, bufferSize, coefficientInfo, numberOfCoefficientSets)) \
  X(GetNormalizationCoefficients, (ViSession vi, ViConstString channelList, ViInt32 bufferSize, hsdigCoefficientInfo coefficientInfo[], ViInt32* numberOfCoefficientSets), (vi, channelList, bufferSize, coefficientInfo, numberOfCoefficientSets)) \
  X(ReadRegister, (ViSession vi, ViInt32 size, ViInt32 offset, ViInt32* value), (vi, size, offset, value)) \
  X(revision_query, (ViSession vi, ViChar driverRev[256], ViChar instrRev[256]), (vi, driverRev, instrRev)) \
  X(self_test, (ViSession vi, ViInt16* testResult, ViChar testMessage[256]), (vi, testResult, testMessage)) \
  /* Measurements */ \
  X(FetchMeasurement, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 scalarMeasFunction, ViReal64* result), (vi, channelList, timeout, scalarMeasFunction, result)) \
  X(ReadMeasurement, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 scalarMeasFunction, ViReal64* result), (vi, channelList, timeout, scalarMeasFunction, result)) \
  X(FetchMeasurementStats, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 scalarMeasFunction, ViReal64* result, ViReal64* mean, ViReal64* stdev, ViReal64* min, ViReal64* max, ViInt32* numInStats), (vi, channelList, timeout, scalarMeasFunction, result, mean, stdev, min, max, numInStats)) \
  X(ClearWaveformMeasurementStats, (ViSession vi, ViConstString channelList, ViInt32 clearableMeasurementFunction), (vi, channelList, clearableMeasurementFunction)) \
  X(FetchArrayMeasurement, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 arrayMeasFunction, ViInt32 measWfmSize, ViReal64 measWfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, arrayMeasFunction, measWfmSize, measWfm, wfmInfo)) \
  /* Data */ \
  X(Fetch, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViReal64 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(FetchBinary8, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViInt8 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(FetchBinary16, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViInt16 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(FetchBinary32, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViInt32 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(FetchComplex, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViReal64 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(FetchComplexBinary16, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViInt16 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(Read, (ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples, ViReal64 wfm[], hsdigWfmInfo wfmInfo[]), (vi, channelList, timeout, numSamples, wfm, wfmInfo)) \
  X(CachedFetch, (ViSession vi, ViConstString channelList, ViInt32 numSamples, ViInt32 dataType, void* wfm, hsdigWfmInfo wfmInfo[]), (vi, channelList, numSamples, dataType, wfm, wfmInfo))

/* Get, Set, Check and GetWithOptions of one numeric attribute type. */
#define HSDIG_ATTRIBUTE_ACCESS(X, T, In) \
  X(SetAttribute##T, (ViSession vi, ViConstString channelList, ViAttr attributeId, In value), (vi, channelList, attributeId, value)) \
  X(CheckAttribute##T, (ViSession vi, ViConstString channelList, ViAttr attributeId, In value), (vi, channelList, attributeId, value)) \
  X(GetAttribute##T, (ViSession vi, ViConstString channelList, ViAttr attributeId, T* value), (vi, channelList, attributeId, value)) \
  X(GetAttributeWithOptions##T, (ViSession vi, ViConstString channelList, ViAttr attributeId, ViInt32 retrievalMode, T* value), (vi, channelList, attributeId, retrievalMode, value))
/* clang-format on */

/* The two functions of the process that hosts the driver, outside the table
 * because the server never calls them. */
#define HSDIG_HOST_FUNCTIONS(X)                                                                 \
  X(InitWithOptions,                                                                            \
    (ViRsrc resourceName, ViBoolean idQuery, ViBoolean resetDevice, ViConstString optionString, \
     ViSession * newVi),                                                                        \
    (resourceName, idQuery, resetDevice, optionString, newVi))                                  \
  X(close, (ViSession vi), (vi))

#endif /* HSDIG_FUNCTIONS_H */
