// The remote interface between the client library and the server that owns the
// instrument. Every request and reply of the service hsdigEP travels as one
// Thrift binary-protocol message in one 4-byte length-prefixed frame.
//
// Rules that hold for every record below:
// - every field has default requiredness: the writer writes them all, in
//   ascending id order; the reader accepts any subset and keeps defaults;
// - driver booleans (ViBoolean) travel as i16 holding 0 or 1; flags of the
//   remoting layer itself (Nulls_ members and the waveform layout switches)
//   are bool;
// - string outputs of the driver travel as list<byte> holding the whole
//   buffer the server handed to the driver, terminator included.
//
// Field ids, types, names and the declaration order of the methods are part
// of the wire contract: never renumber or reorder them.

namespace cpp hsdig

// ---------------------------------------------------------------------------
// Common records

// The outcome carried by every reply: a driver-style status (negative error,
// positive warning, 0 success) and its text in the session's language.
struct RetStatus {
  1: i32 code,
  2: string localizedTextDescription,
}

// Reply of registerClientSession.
struct RetRegisterClientSession {
  1: RetStatus status,
  2: i32 clientID,
  3: i32 stolenClientID,
}

// Timing and scaling of one fetched record (waveform).
struct TypeWfmInfo {
  1: i32 actualSamples,
  2: double absoluteInitialX,
  3: double relativeInitialX,
  4: double xIncrement,
  5: double offset,
  6: double gain,
  7: double reserved1,
  8: double reserved2,
}

// Reply of omniReadOrFetch and fetchArrayMeasurement. wfmData holds the
// samples of all records as one raw block in the requested sample format.
struct RetWfmRecords {
  1: RetStatus status,
  2: i32 numRecords,
  3: i32 numPoints,
  4: list<TypeWfmInfo> wfmInfoList,
  5: string wfmData,
}

// Reply of revision_query.
struct RetRevisionQuery {
  1: RetStatus status,
  2: string driverRev,
  3: string instrRev,
}

// Reply of self_test.
struct RetSelfTest {
  1: RetStatus status,
  2: i16 testResult,
  3: string testMessage,
}

// One set of scaling coefficients.
struct CoefficientInfo {
  1: double offset,
  2: double gain,
  3: double reserved1,
  4: double reserved2,
}

// Reply of getScalingOrNormalizationCoefficients.
struct RetCoefficients {
  1: RetStatus status,
  2: list<CoefficientInfo> coefficientInfoList,
  3: i32 numberOfCoefficientSets,
}

// ---------------------------------------------------------------------------
// Null-pointer flags: one record per driver function with pointer arguments.
// A field is true when the caller passed a null pointer for the argument (or
// output) of the same name; the server then hands the driver a null pointer.

struct Nulls_hsdig_AcquisitionStatus {
  1: bool acquisitionStatus,
}

struct Nulls_hsdig_ActualMeasWfmSize {
  1: bool measWaveformSize,
}

struct Nulls_hsdig_ActualNumWfms {
  1: bool channelList,
  2: bool numWfms,
}

struct Nulls_hsdig_ActualRecordLength {
  1: bool recordLength,
}

struct Nulls_hsdig_AddWaveformProcessing {
  1: bool channelList,
}

struct Nulls_hsdig_AttributeWasSetByUser {
  1: bool repCapName,
  2: bool wasSetByUser,
}

struct Nulls_hsdig_CalSelfCalibrate {
  1: bool channelList,
}

struct Nulls_hsdig_CheckAttributeViBoolean {
  1: bool channelList,
}

struct Nulls_hsdig_CheckAttributeViInt32 {
  1: bool channelList,
}

struct Nulls_hsdig_CheckAttributeViInt64 {
  1: bool channelList,
}

struct Nulls_hsdig_CheckAttributeViReal64 {
  1: bool channelList,
}

struct Nulls_hsdig_CheckAttributeViSession {
  1: bool channelList,
}

struct Nulls_hsdig_CheckAttributeViString {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_ClearWaveformMeasurementStats {
  1: bool channelList,
}

struct Nulls_hsdig_ClearWaveformProcessing {
  1: bool channelList,
}

struct Nulls_hsdig_ConfigureChanCharacteristics {
  1: bool channelList,
}

struct Nulls_hsdig_ConfigureClock {
  1: bool inputClockSource,
  2: bool outputClockSource,
  3: bool clockSyncPulseSource,
}

struct Nulls_hsdig_ConfigureEqualizationFilterCoefficients {
  1: bool channelList,
  2: bool coefficients,
}

struct Nulls_hsdig_ConfigureTriggerDigital {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerEdge {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerGlitch {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerHysteresis {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerRunt {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerVideo {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerWidth {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureTriggerWindow {
  1: bool triggerSource,
}

struct Nulls_hsdig_ConfigureVertical {
  1: bool channelList,
}

struct Nulls_hsdig_ExportAttributeConfigurationBuffer {
  1: bool configuration,
}

struct Nulls_hsdig_ExportAttributeConfigurationFile {
  1: bool filePath,
}

struct Nulls_hsdig_ExportSignal {
  1: bool signalIdentifier,
  2: bool outputTerminal,
}

struct Nulls_hsdig_FetchMeasurement {
  1: bool channelList,
  2: bool result,
}

struct Nulls_hsdig_FetchMeasurementStats {
  1: bool channelList,
  2: bool result,
  3: bool mean,
  4: bool stdev,
  5: bool min,
  6: bool max,
  7: bool numInStats,
}

struct Nulls_hsdig_GetAttributeFlags {
  1: bool flags,
  2: bool supported,
}

struct Nulls_hsdig_GetAttributeViBoolean {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeViInt32 {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeViInt64 {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeViReal64 {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeViSession {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeViString {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeWithOptionsViBoolean {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeWithOptionsViInt32 {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeWithOptionsViInt64 {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeWithOptionsViReal64 {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeWithOptionsViSession {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetAttributeWithOptionsViString {
  1: bool channelList,
  2: bool value,
}

struct Nulls_hsdig_GetChannelNameFromString {
  1: bool index,
  2: bool name,
}

struct Nulls_hsdig_GetEqualizationFilterCoefficients {
  1: bool channel,
  2: bool coefficients,
}

struct Nulls_hsdig_GetFrequencyResponse {
  1: bool channel,
  2: bool frequencies,
  3: bool amplitudes,
  4: bool phases,
  5: bool numberOfFrequencies,
}

struct Nulls_hsdig_GetSessionState {
  1: bool channelName,
  2: bool sessionState,
}

struct Nulls_hsdig_GetStartTimestampInformation {
  1: bool sysTimeIn128BitsT1,
  2: bool sysTimeIn128BitsT2,
  3: bool sysTimeIn128BitsT3,
  4: bool sysTimeIn128BitsT4,
  5: bool deviceTimeInAbsoluteTimeUnits,
}

struct Nulls_hsdig_GetStreamEndpointHandle {
  1: bool streamName,
  2: bool writerHandle,
}

struct Nulls_hsdig_ImportAttributeConfigurationBuffer {
  1: bool configuration,
}

struct Nulls_hsdig_ImportAttributeConfigurationFile {
  1: bool filePath,
}

struct Nulls_hsdig_ParseNumberOfChannels {
  1: bool channel,
  2: bool numChannels,
}

struct Nulls_hsdig_ReadMeasurement {
  1: bool channelList,
  2: bool result,
}

struct Nulls_hsdig_ReadRegister {
  1: bool value,
}

struct Nulls_hsdig_ResetAttribute {
  1: bool channelList,
}

struct Nulls_hsdig_SampleMode {
  1: bool sampleMode,
}

struct Nulls_hsdig_SampleRate {
  1: bool sampleRate,
}

struct Nulls_hsdig_SetAttributeViBoolean {
  1: bool channelList,
}

struct Nulls_hsdig_SetAttributeViInt32 {
  1: bool channelList,
}

struct Nulls_hsdig_SetAttributeViInt64 {
  1: bool channelList,
}

struct Nulls_hsdig_SetAttributeViReal64 {
  1: bool channelList,
}

struct Nulls_hsdig_SetAttributeViSession {
  1: bool channelList,
}

struct Nulls_hsdig_SetAttributeViString {
  1: bool channelList,
  2: bool value,
}

// ---------------------------------------------------------------------------
// Status plus outputs: one record per driver function that returns values
// besides its status. returnSizeOnNullArray carries the driver's return value
// unchanged when the request's buffer size was 0.

struct Ret_hsdig_AcquisitionStatus {
  1: RetStatus status,
  2: i32 acquisitionStatus,
}

struct Ret_hsdig_ActualMeasWfmSize {
  1: RetStatus status,
  2: i32 measWaveformSize,
}

struct Ret_hsdig_ActualNumWfms {
  1: RetStatus status,
  2: i32 numWfms,
}

struct Ret_hsdig_ActualRecordLength {
  1: RetStatus status,
  2: i32 recordLength,
}

struct Ret_hsdig_AttributeWasSetByUser {
  1: RetStatus status,
  2: i16 wasSetByUser,
}

struct Ret_hsdig_ExportAttributeConfigurationBuffer {
  1: RetStatus status,
  2: list<byte> configuration,
}

struct Ret_hsdig_FetchMeasurement {
  1: RetStatus status,
  2: double result,
}

struct Ret_hsdig_FetchMeasurementStats {
  1: RetStatus status,
  2: double result,
  3: double mean,
  4: double stdev,
  5: double min,
  6: double max,
  7: i32 numInStats,
}

struct Ret_hsdig_GetAttributeFlags {
  1: RetStatus status,
  2: i32 flags,
  3: i16 supported,
}

struct Ret_hsdig_GetAttributeViBoolean {
  1: RetStatus status,
  2: i16 value,
}

struct Ret_hsdig_GetAttributeViInt32 {
  1: RetStatus status,
  2: i32 value,
}

struct Ret_hsdig_GetAttributeViInt64 {
  1: RetStatus status,
  2: i64 value,
}

struct Ret_hsdig_GetAttributeViReal64 {
  1: RetStatus status,
  2: double value,
}

struct Ret_hsdig_GetAttributeViSession {
  1: RetStatus status,
  2: i32 value,
}

struct Ret_hsdig_GetAttributeViString {
  1: RetStatus status,
  2: list<byte> value,
  3: i32 returnSizeOnNullArray,
}

struct Ret_hsdig_GetAttributeWithOptionsViBoolean {
  1: RetStatus status,
  2: i16 value,
}

struct Ret_hsdig_GetAttributeWithOptionsViInt32 {
  1: RetStatus status,
  2: i32 value,
}

struct Ret_hsdig_GetAttributeWithOptionsViInt64 {
  1: RetStatus status,
  2: i64 value,
}

struct Ret_hsdig_GetAttributeWithOptionsViReal64 {
  1: RetStatus status,
  2: double value,
}

struct Ret_hsdig_GetAttributeWithOptionsViSession {
  1: RetStatus status,
  2: i32 value,
}

struct Ret_hsdig_GetAttributeWithOptionsViString {
  1: RetStatus status,
  2: list<byte> value,
  3: i32 returnSizeOnNullArray,
}

struct Ret_hsdig_GetChannelNameFromString {
  1: RetStatus status,
  2: list<byte> name,
  3: i32 returnSizeOnNullArray,
}

struct Ret_hsdig_GetEqualizationFilterCoefficients {
  1: RetStatus status,
  2: list<double> coefficients,
}

struct Ret_hsdig_GetFrequencyResponse {
  1: RetStatus status,
  2: list<double> frequencies,
  3: list<double> amplitudes,
  4: list<double> phases,
  5: i32 numberOfFrequencies,
}

struct Ret_hsdig_GetSessionState {
  1: RetStatus status,
  2: i32 sessionState,
}

struct Ret_hsdig_GetStartTimestampInformation {
  1: RetStatus status,
  2: i32 sysTimeIn128BitsT1,
  3: i32 sysTimeIn128BitsT2,
  4: i32 sysTimeIn128BitsT3,
  5: i32 sysTimeIn128BitsT4,
  6: double deviceTimeInAbsoluteTimeUnits,
}

struct Ret_hsdig_GetStreamEndpointHandle {
  1: RetStatus status,
  2: i32 writerHandle,
}

struct Ret_hsdig_ParseNumberOfChannels {
  1: RetStatus status,
  2: i32 numChannels,
}

struct Ret_hsdig_ReadMeasurement {
  1: RetStatus status,
  2: double result,
}

struct Ret_hsdig_ReadRegister {
  1: RetStatus status,
  2: i32 value,
}

struct Ret_hsdig_SampleMode {
  1: RetStatus status,
  2: i32 sampleMode,
}

struct Ret_hsdig_SampleRate {
  1: RetStatus status,
  2: double sampleRate,
}

// ---------------------------------------------------------------------------
// The service. Declaration order is the order of the handler interface's
// operations and of the dispatcher's registration. Methods 94 to 98 name the
// session clientID and carry no nulls record. Field 2 of omniReadOrFetch is
// spelled channeList on purpose: that is its name in the contract.

service hsdigEP {
  /*  1 */ void pingServer(),
  /*  2 */ RetRegisterClientSession registerClientSession(1: string devGUID, 2: i32 processID),
  /*  3 */ RetStatus unregisterClientSession(1: i32 clientID),
  /*  4 */ Ret_hsdig_GetStartTimestampInformation getStartTimestampInformation(1: Nulls_hsdig_GetStartTimestampInformation nulls, 2: i32 vi),
  /*  5 */ RetStatus commit(1: i32 vi),
  /*  6 */ RetStatus saveAttributes(1: i32 vi),
  /*  7 */ Ret_hsdig_GetAttributeWithOptionsViInt64 getAttributeWithOptionsViInt64(1: Nulls_hsdig_GetAttributeWithOptionsViInt64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 retrievalMode),
  /*  8 */ RetStatus addWaveformProcessing(1: Nulls_hsdig_AddWaveformProcessing nulls, 2: i32 vi, 3: string channelList, 4: i32 measFunction),
  /*  9 */ RetStatus resetDevice(1: i32 vi),
  /* 10 */ RetStatus importAttributeConfigurationBuffer(1: Nulls_hsdig_ImportAttributeConfigurationBuffer nulls, 2: i32 vi, 3: i32 sizeInBytes, 4: list<byte> configuration),
  /* 11 */ RetStatus autoSetup(1: i32 vi),
  /* 12 */ RetStatus reset(1: i32 vi),
  /* 13 */ Ret_hsdig_GetAttributeViReal64 getAttributeViReal64(1: Nulls_hsdig_GetAttributeViReal64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId),
  /* 14 */ Ret_hsdig_ActualMeasWfmSize actualMeasWfmSize(1: Nulls_hsdig_ActualMeasWfmSize nulls, 2: i32 vi, 3: i32 arrayMeasFunction),
  /* 15 */ Ret_hsdig_GetAttributeViInt32 getAttributeViInt32(1: Nulls_hsdig_GetAttributeViInt32 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId),
  /* 16 */ RetStatus checkAttributeViInt32(1: Nulls_hsdig_CheckAttributeViInt32 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 value),
  /* 17 */ RetStatus checkAttributeViBoolean(1: Nulls_hsdig_CheckAttributeViBoolean nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i16 value),
  /* 18 */ RetStatus checkAttributeViReal64(1: Nulls_hsdig_CheckAttributeViReal64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: double value),
  /* 19 */ Ret_hsdig_ReadMeasurement readMeasurement(1: Nulls_hsdig_ReadMeasurement nulls, 2: i32 vi, 3: string channelList, 4: double timeout, 5: i32 scalarMeasFunction),
  /* 20 */ Ret_hsdig_FetchMeasurement fetchMeasurement(1: Nulls_hsdig_FetchMeasurement nulls, 2: i32 vi, 3: string channelList, 4: double timeout, 5: i32 scalarMeasFunction),
  /* 21 */ Ret_hsdig_GetAttributeWithOptionsViReal64 getAttributeWithOptionsViReal64(1: Nulls_hsdig_GetAttributeWithOptionsViReal64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 retrievalMode),
  /* 22 */ Ret_hsdig_ExportAttributeConfigurationBuffer exportAttributeConfigurationBuffer(1: Nulls_hsdig_ExportAttributeConfigurationBuffer nulls, 2: i32 vi, 3: i32 sizeInBytes),
  /* 23 */ Ret_hsdig_GetStreamEndpointHandle getStreamEndpointHandle(1: Nulls_hsdig_GetStreamEndpointHandle nulls, 2: i32 vi, 3: string streamName),
  /* 24 */ Ret_hsdig_SampleRate sampleRate(1: Nulls_hsdig_SampleRate nulls, 2: i32 vi),
  /* 25 */ RetStatus configureVertical(1: Nulls_hsdig_ConfigureVertical nulls, 2: i32 vi, 3: string channelList, 4: double range, 5: double offset, 6: i32 coupling, 7: double probeAttenuation, 8: i16 enabled),
  /* 26 */ RetStatus configureAcquisition(1: i32 vi, 2: i32 acquisitionType),
  /* 27 */ Ret_hsdig_ReadRegister readRegister(1: Nulls_hsdig_ReadRegister nulls, 2: i32 vi, 3: i32 size, 4: i32 offset),
  /* 28 */ RetStatus setAttributeViSession(1: Nulls_hsdig_SetAttributeViSession nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 value),
  /* 29 */ RetStatus resetAllAttributes(1: i32 vi),
  /* 30 */ Ret_hsdig_FetchMeasurementStats fetchMeasurementStats(1: Nulls_hsdig_FetchMeasurementStats nulls, 2: i32 vi, 3: string channelList, 4: double timeout, 5: i32 scalarMeasFunction),
  /* 31 */ RetStatus setAttributeViInt64(1: Nulls_hsdig_SetAttributeViInt64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i64 value),
  /* 32 */ RetStatus configureEqualizationFilterCoefficients(1: Nulls_hsdig_ConfigureEqualizationFilterCoefficients nulls, 2: i32 vi, 3: string channelList, 4: i32 numberOfCoefficients, 5: list<double> coefficients),
  /* 33 */ RetStatus configureTriggerWidth(1: Nulls_hsdig_ConfigureTriggerWidth nulls, 2: i32 vi, 3: string triggerSource, 4: double level, 5: double lowThreshold, 6: double highThreshold, 7: i32 polarity, 8: i32 condition, 9: i32 triggerCoupling, 10: double holdoff, 11: double delay),
  /* 34 */ RetStatus configureTriggerWindow(1: Nulls_hsdig_ConfigureTriggerWindow nulls, 2: i32 vi, 3: string triggerSource, 4: double lowLevel, 5: double highLevel, 6: i32 windowMode, 7: i32 triggerCoupling, 8: double holdoff, 9: double delay),
  /* 35 */ RetStatus requestPrivilege(1: i32 vi, 2: i32 privilegeLevel),
  /* 36 */ RetStatus resetAttribute(1: Nulls_hsdig_ResetAttribute nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId),
  /* 37 */ Ret_hsdig_ActualRecordLength actualRecordLength(1: Nulls_hsdig_ActualRecordLength nulls, 2: i32 vi),
  /* 38 */ RetStatus importAttributes(1: i32 vi),
  /* 39 */ RetStatus restoreAttributes(1: i32 vi),
  /* 40 */ RetStatus setAttributeViString(1: Nulls_hsdig_SetAttributeViString nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: string value),
  /* 41 */ RetStatus initiateAcquisition(1: i32 vi),
  /* 42 */ RetStatus clearWaveformMeasurementStats(1: Nulls_hsdig_ClearWaveformMeasurementStats nulls, 2: i32 vi, 3: string channelList, 4: i32 clearableMeasurementFunction),
  /* 43 */ RetStatus disable(1: i32 vi),
  /* 44 */ RetStatus setAttributeViBoolean(1: Nulls_hsdig_SetAttributeViBoolean nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i16 value),
  /* 45 */ RetStatus checkAttributeViSession(1: Nulls_hsdig_CheckAttributeViSession nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 value),
  /* 46 */ RetStatus importAttributeConfigurationFile(1: Nulls_hsdig_ImportAttributeConfigurationFile nulls, 2: i32 vi, 3: string filePath),
  /* 47 */ Ret_hsdig_GetAttributeFlags getAttributeFlags(1: Nulls_hsdig_GetAttributeFlags nulls, 2: i32 vi, 3: i32 attributeId),
  /* 48 */ Ret_hsdig_GetAttributeWithOptionsViString getAttributeWithOptionsViString(1: Nulls_hsdig_GetAttributeWithOptionsViString nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 retrievalMode, 6: i32 bufSize),
  /* 49 */ Ret_hsdig_GetAttributeWithOptionsViSession getAttributeWithOptionsViSession(1: Nulls_hsdig_GetAttributeWithOptionsViSession nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 retrievalMode),
  /* 50 */ RetStatus checkAttributeViInt64(1: Nulls_hsdig_CheckAttributeViInt64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i64 value),
  /* 51 */ RetStatus clearWaveformProcessing(1: Nulls_hsdig_ClearWaveformProcessing nulls, 2: i32 vi, 3: string channelList),
  /* 52 */ Ret_hsdig_GetAttributeViInt64 getAttributeViInt64(1: Nulls_hsdig_GetAttributeViInt64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId),
  /* 53 */ RetStatus exportAttributeConfigurationFile(1: Nulls_hsdig_ExportAttributeConfigurationFile nulls, 2: i32 vi, 3: string filePath),
  /* 54 */ RetStatus configureChanCharacteristics(1: Nulls_hsdig_ConfigureChanCharacteristics nulls, 2: i32 vi, 3: string channelList, 4: double inputImpedance, 5: double maxInputFrequency),
  /* 55 */ Ret_hsdig_ActualNumWfms actualNumWfms(1: Nulls_hsdig_ActualNumWfms nulls, 2: i32 vi, 3: string channelList),
  /* 56 */ RetStatus calSelfCalibrate(1: Nulls_hsdig_CalSelfCalibrate nulls, 2: i32 vi, 3: string channelList, 4: i32 option),
  /* 57 */ Ret_hsdig_ParseNumberOfChannels parseNumberOfChannels(1: Nulls_hsdig_ParseNumberOfChannels nulls, 2: i32 vi, 3: string channel),
  /* 58 */ RetStatus writeRegister(1: i32 vi, 2: i32 size, 3: i32 offset, 4: i32 value),
  /* 59 */ Ret_hsdig_GetAttributeWithOptionsViInt32 getAttributeWithOptionsViInt32(1: Nulls_hsdig_GetAttributeWithOptionsViInt32 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 retrievalMode),
  /* 60 */ Ret_hsdig_GetAttributeWithOptionsViBoolean getAttributeWithOptionsViBoolean(1: Nulls_hsdig_GetAttributeWithOptionsViBoolean nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 retrievalMode),
  /* 61 */ Ret_hsdig_AcquisitionStatus acquisitionStatus(1: Nulls_hsdig_AcquisitionStatus nulls, 2: i32 vi),
  /* 62 */ RetStatus adjustSampleClockRelativeDelay(1: i32 vi, 2: double delay),
  /* 63 */ RetStatus cableSenseSignalStop(1: i32 vi),
  /* 64 */ RetStatus configureTriggerSoftware(1: i32 vi, 2: double holdoff, 3: double delay),
  /* 65 */ RetStatus configureClock(1: Nulls_hsdig_ConfigureClock nulls, 2: i32 vi, 3: string inputClockSource, 4: string outputClockSource, 5: string clockSyncPulseSource, 6: i16 masterEnabled),
  /* 66 */ RetStatus probeCompensationSignalStart(1: i32 vi),
  /* 67 */ RetStatus exportSignal(1: Nulls_hsdig_ExportSignal nulls, 2: i32 vi, 3: i32 signal, 4: string signalIdentifier, 5: string outputTerminal),
  /* 68 */ RetStatus configureTriggerEdge(1: Nulls_hsdig_ConfigureTriggerEdge nulls, 2: i32 vi, 3: string triggerSource, 4: double level, 5: i32 slope, 6: i32 triggerCoupling, 7: double holdoff, 8: double delay),
  /* 69 */ RetStatus sendSoftwareTriggerEdge(1: i32 vi, 2: i32 whichTrigger),
  /* 70 */ RetStatus configureTriggerRunt(1: Nulls_hsdig_ConfigureTriggerRunt nulls, 2: i32 vi, 3: string triggerSource, 4: double lowThreshold, 5: double highThreshold, 6: i32 polarity, 7: i32 triggerCoupling, 8: double holdoff, 9: double delay),
  /* 71 */ RetStatus configureTriggerGlitch(1: Nulls_hsdig_ConfigureTriggerGlitch nulls, 2: i32 vi, 3: string triggerSource, 4: double level, 5: double width, 6: i32 polarity, 7: i32 glitchCondition, 8: i32 triggerCoupling, 9: double holdoff, 10: double delay),
  /* 72 */ RetStatus configureTriggerVideo(1: Nulls_hsdig_ConfigureTriggerVideo nulls, 2: i32 vi, 3: string triggerSource, 4: i16 enableDcRestore, 5: i32 signalFormat, 6: i32 event, 7: i32 lineNumber, 8: i32 polarity, 9: i32 triggerCoupling, 10: double holdoff, 11: double delay),
  /* 73 */ RetStatus setAttributeViReal64(1: Nulls_hsdig_SetAttributeViReal64 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: double value),
  /* 74 */ Ret_hsdig_GetAttributeViBoolean getAttributeViBoolean(1: Nulls_hsdig_GetAttributeViBoolean nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId),
  /* 75 */ RetStatus cableSenseSignalStart(1: i32 vi),
  /* 76 */ RetStatus checkAttributeViString(1: Nulls_hsdig_CheckAttributeViString nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: string value),
  /* 77 */ Ret_hsdig_GetFrequencyResponse getFrequencyResponse(1: Nulls_hsdig_GetFrequencyResponse nulls, 2: i32 vi, 3: string channel, 4: i32 bufferSize),
  /* 78 */ Ret_hsdig_GetChannelNameFromString getChannelNameFromString(1: Nulls_hsdig_GetChannelNameFromString nulls, 2: i32 vi, 3: string index, 4: i32 bufferSize),
  /* 79 */ Ret_hsdig_AttributeWasSetByUser attributeWasSetByUser(1: Nulls_hsdig_AttributeWasSetByUser nulls, 2: i32 vi, 3: string repCapName, 4: i32 attributeId),
  /* 80 */ RetStatus configureTriggerDigital(1: Nulls_hsdig_ConfigureTriggerDigital nulls, 2: i32 vi, 3: string triggerSource, 4: i32 slope, 5: double holdoff, 6: double delay),
  /* 81 */ RetStatus setAttributeViInt32(1: Nulls_hsdig_SetAttributeViInt32 nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 value),
  /* 82 */ Ret_hsdig_GetAttributeViSession getAttributeViSession(1: Nulls_hsdig_GetAttributeViSession nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId),
  /* 83 */ RetStatus exportAttributes(1: i32 vi),
  /* 84 */ RetStatus abort(1: i32 vi),
  /* 85 */ RetStatus uncommit(1: i32 vi),
  /* 86 */ Ret_hsdig_SampleMode sampleMode(1: Nulls_hsdig_SampleMode nulls, 2: i32 vi),
  /* 87 */ Ret_hsdig_GetAttributeViString getAttributeViString(1: Nulls_hsdig_GetAttributeViString nulls, 2: i32 vi, 3: string channelList, 4: i32 attributeId, 5: i32 bufSize),
  /* 88 */ Ret_hsdig_GetSessionState getSessionState(1: Nulls_hsdig_GetSessionState nulls, 2: i32 vi, 3: string channelName),
  /* 89 */ RetStatus configureHorizontalTiming(1: i32 vi, 2: double minSampleRate, 3: i32 minNumPts, 4: double refPosition, 5: i32 numRecords, 6: i16 enforceRealtime),
  /* 90 */ RetStatus configureTriggerImmediate(1: i32 vi),
  /* 91 */ RetStatus configureTriggerHysteresis(1: Nulls_hsdig_ConfigureTriggerHysteresis nulls, 2: i32 vi, 3: string triggerSource, 4: double level, 5: double hysteresis, 6: i32 slope, 7: i32 triggerCoupling, 8: double holdoff, 9: double delay),
  /* 92 */ RetStatus probeCompensationSignalStop(1: i32 vi),
  /* 93 */ Ret_hsdig_GetEqualizationFilterCoefficients getEqualizationFilterCoefficients(1: Nulls_hsdig_GetEqualizationFilterCoefficients nulls, 2: i32 vi, 3: string channel, 4: i32 numberOfCoefficients),
  /* 94 */ RetCoefficients getScalingOrNormalizationCoefficients(1: i32 clientID, 2: string channelList, 3: i32 bufferSize, 4: bool isNormalization),
  /* 95 */ RetRevisionQuery revision_query(1: i32 clientID),
  /* 96 */ RetSelfTest self_test(1: i32 clientID),
  /* 97 */ RetWfmRecords fetchArrayMeasurement(1: i32 clientID, 2: string channelList, 3: double timeout, 4: i32 arrayMeasFunction, 5: i32 measWfmSize, 6: bool allowMultipleRecords),
  /* 98 */ RetWfmRecords omniReadOrFetch(1: i32 clientID, 2: string channeList, 3: double timeout, 4: i32 numSamples, 5: i32 dataType, 6: bool isFetch, 7: bool allowMultipleRecords, 8: bool isInterleaved),}
