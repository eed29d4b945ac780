/* The attributes of the simulated digitizer: one table, HSDIG_ATTRIBUTES(X),
 * with one row per attribute:
 *
 *   X(NAME, id, type, scope, default, min, max, flags)
 *
 * - NAME: the attribute's name; HSDIG_ATTR_<NAME> is its id.
 * - type: ViInt32, ViInt64, ViReal64, ViBoolean, ViSession or ViString.
 * - scope: CHANNEL (one value per channel; the channel list names "0" to
 *   "N-1") or SESSION (one value; the channel list must be empty).
 * - default, min, max: the value after a reset and the accepted range
 *   (inclusive). Strings have no range (min and max are 0) and take the
 *   values their Configure function documents.
 * - flags: 0, or HSDIG_ATTR_READ_ONLY for values the driver keeps itself.
 *
 * The table drives the ids below, the engine attributes the driver defines
 * for each session, range checking and the configuration export/import. */
#ifndef HSDIG_ATTRIBUTES_H
#define HSDIG_ATTRIBUTES_H

#define HSDIG_ATTR_READ_ONLY 1

/* clang-format off */
#define HSDIG_ATTRIBUTES(X) \
  /* Vertical, per channel */ \
  X(VERTICAL_RANGE, 1250001, ViReal64, CHANNEL, 1.0, 0.01, 100.0, 0)                /* volts full scale at the probe tip */ \
  X(VERTICAL_OFFSET, 1250002, ViReal64, CHANNEL, 0.0, -50.0, 50.0, 0)              /* volts at the centre of the range */ \
  X(VERTICAL_COUPLING, 1250003, ViInt32, CHANNEL, 1, 0, 2, 0)                      /* HSDIG_VAL_AC, _DC, _GND */ \
  X(PROBE_ATTENUATION, 1250004, ViReal64, CHANNEL, 1.0, 0.001, 1000.0, 0) \
  X(CHANNEL_ENABLED, 1250005, ViBoolean, CHANNEL, 1, 0, 1, 0) \
  X(INPUT_IMPEDANCE, 1250006, ViReal64, CHANNEL, 1.0e6, 50.0, 1.0e6, 0)            /* ohms: 50 or 1e6 */ \
  X(MAX_INPUT_FREQUENCY, 1250007, ViReal64, CHANNEL, 0.0, 0.0, 1.0e10, 0)          /* hertz; 0 is the model's bandwidth */ \
  X(CHANNEL_LABEL, 1250008, ViString, CHANNEL, "", 0, 0, 0) \
  X(EQUALIZATION_FILTER_ENABLED, 1250009, ViBoolean, CHANNEL, 0, 0, 1, 0) \
  /* The simulated signal at the channel's input connector, per channel */ \
  X(SIGNAL_SHAPE, 1250101, ViInt32, CHANNEL, 1, 0, 4, 0)                           /* HSDIG_VAL_SHAPE_... */ \
  X(SIGNAL_FREQUENCY, 1250102, ViReal64, CHANNEL, 1.0e6, 0.0, 1.0e10, 0)           /* hertz */ \
  X(SIGNAL_AMPLITUDE, 1250103, ViReal64, CHANNEL, 0.4, 0.0, 100.0, 0)              /* volts peak */ \
  X(SIGNAL_OFFSET, 1250104, ViReal64, CHANNEL, 0.0, -100.0, 100.0, 0)              /* volts */ \
  X(SIGNAL_NOISE, 1250105, ViReal64, CHANNEL, 0.0, 0.0, 10.0, 0)                   /* volts RMS */ \
  X(SIGNAL_PHASE, 1250106, ViReal64, CHANNEL, 0.0, -360.0, 360.0, 0)               /* degrees */ \
  X(SIGNAL_DUTY_CYCLE, 1250107, ViReal64, CHANNEL, 50.0, 1.0, 99.0, 0)             /* percent, square waves */ \
  /* Horizontal and acquisition */ \
  X(SAMPLE_RATE, 1250201, ViReal64, SESSION, 100.0e6, 1.0e3, 1.0e10, 0)            /* coerced to the model's maximum */ \
  X(RECORD_LENGTH, 1250202, ViInt32, SESSION, 1000, 1, 67108864, 0) \
  X(NUM_RECORDS, 1250203, ViInt32, SESSION, 1, 1, 100000, 0) \
  X(REF_POSITION, 1250204, ViReal64, SESSION, 50.0, 0.0, 100.0, 0)                 /* percent of the record before the trigger */ \
  X(ENFORCE_REALTIME, 1250205, ViBoolean, SESSION, 1, 0, 1, 0) \
  X(ACQUISITION_TYPE, 1250206, ViInt32, SESSION, 0, 0, 2, 0)                       /* HSDIG_VAL_NORMAL, _FLEXRES, _DDC */ \
  X(SAMPLE_MODE, 1250207, ViInt32, SESSION, 0, 0, 1, 0)                            /* HSDIG_VAL_REAL_TIME, _EQUIVALENT_TIME */ \
  X(ACQUISITION_START_TIME, 1250208, ViInt64, SESSION, 0, 0, 9223372036854775807LL, HSDIG_ATTR_READ_ONLY) /* ns since the session opened */ \
  X(ACQUISITION_COUNT, 1250209, ViInt64, SESSION, 0, 0, 9223372036854775807LL, HSDIG_ATTR_READ_ONLY) \
  /* Trigger */ \
  X(TRIGGER_TYPE, 1250301, ViInt32, SESSION, 6, 1, 10, 0)                          /* HSDIG_VAL_..._TRIGGER */ \
  X(TRIGGER_SOURCE, 1250302, ViString, SESSION, "0", 0, 0, 0)                      /* a channel, "External", "PFI0", "PFI1" */ \
  X(TRIGGER_LEVEL, 1250303, ViReal64, SESSION, 0.0, -100.0, 100.0, 0) \
  X(TRIGGER_SLOPE, 1250304, ViInt32, SESSION, 1, 0, 1, 0)                          /* HSDIG_VAL_NEGATIVE, _POSITIVE */ \
  X(TRIGGER_COUPLING, 1250305, ViInt32, SESSION, 1, 0, 4, 0)                       /* HSDIG_VAL_TRIGGER_COUPLING_... */ \
  X(TRIGGER_HOLDOFF, 1250306, ViReal64, SESSION, 0.0, 0.0, 1000.0, 0)              /* seconds */ \
  X(TRIGGER_DELAY, 1250307, ViReal64, SESSION, 0.0, -1000.0, 1000.0, 0)            /* seconds */ \
  X(TRIGGER_HYSTERESIS, 1250308, ViReal64, SESSION, 0.0, 0.0, 100.0, 0) \
  X(TRIGGER_LOW_LEVEL, 1250309, ViReal64, SESSION, 0.0, -100.0, 100.0, 0)          /* window and runt */ \
  X(TRIGGER_HIGH_LEVEL, 1250310, ViReal64, SESSION, 0.0, -100.0, 100.0, 0)         /* window and runt */ \
  X(TRIGGER_WINDOW_MODE, 1250311, ViInt32, SESSION, 0, 0, 1, 0)                    /* HSDIG_VAL_ENTERING_WINDOW, _LEAVING_WINDOW */ \
  X(TRIGGER_POLARITY, 1250312, ViInt32, SESSION, 0, 0, 2, 0)                       /* HSDIG_VAL_POLARITY_... */ \
  X(TRIGGER_WIDTH_LOW, 1250313, ViReal64, SESSION, 0.0, 0.0, 1000.0, 0)            /* seconds */ \
  X(TRIGGER_WIDTH_HIGH, 1250314, ViReal64, SESSION, 0.0, 0.0, 1000.0, 0)           /* seconds */ \
  X(TRIGGER_WIDTH_CONDITION, 1250315, ViInt32, SESSION, 0, 0, 1, 0)                /* HSDIG_VAL_WITHIN, _OUTSIDE */ \
  X(TRIGGER_GLITCH_WIDTH, 1250316, ViReal64, SESSION, 0.0, 0.0, 1000.0, 0)         /* seconds */ \
  X(TRIGGER_GLITCH_CONDITION, 1250317, ViInt32, SESSION, 0, 0, 1, 0)               /* HSDIG_VAL_LESS_THAN, _GREATER_THAN */ \
  X(TRIGGER_VIDEO_DC_RESTORE, 1250318, ViBoolean, SESSION, 0, 0, 1, 0) \
  X(TRIGGER_VIDEO_FORMAT, 1250319, ViInt32, SESSION, 0, 0, 3, 0)                   /* HSDIG_VAL_NTSC, _PAL, _SECAM, _M_PAL */ \
  X(TRIGGER_VIDEO_EVENT, 1250320, ViInt32, SESSION, 0, 0, 4, 0)                    /* HSDIG_VAL_VIDEO_... */ \
  X(TRIGGER_VIDEO_LINE, 1250321, ViInt32, SESSION, 1, 1, 625, 0) \
  /* Clock, exported signals, signal outputs */ \
  X(INPUT_CLOCK_SOURCE, 1250401, ViString, SESSION, "Internal", 0, 0, 0)          /* "Internal", "ClkIn", "RefIn" */ \
  X(OUTPUT_CLOCK_SOURCE, 1250402, ViString, SESSION, "None", 0, 0, 0)             /* "None", "ClkOut", "RefOut" */ \
  X(CLOCK_SYNC_PULSE_SOURCE, 1250403, ViString, SESSION, "None", 0, 0, 0)         /* "None", "SyncIn", "PFI0", "PFI1" */ \
  X(MASTER_ENABLED, 1250404, ViBoolean, SESSION, 0, 0, 1, 0) \
  X(SAMPLE_CLOCK_DELAY, 1250405, ViReal64, SESSION, 0.0, -1.0e-6, 1.0e-6, 0)      /* seconds */ \
  X(EXPORTED_REF_CLOCK_TERMINAL, 1250410, ViString, SESSION, "None", 0, 0, 0) \
  X(EXPORTED_START_TRIGGER_TERMINAL, 1250411, ViString, SESSION, "None", 0, 0, 0) \
  X(EXPORTED_REF_TRIGGER_TERMINAL, 1250412, ViString, SESSION, "None", 0, 0, 0) \
  X(EXPORTED_END_OF_RECORD_TERMINAL, 1250413, ViString, SESSION, "None", 0, 0, 0) \
  X(EXPORTED_READY_FOR_START_TERMINAL, 1250414, ViString, SESSION, "None", 0, 0, 0) \
  X(PROBE_COMPENSATION_ENABLED, 1250420, ViBoolean, SESSION, 0, 0, 1, HSDIG_ATTR_READ_ONLY) \
  X(CABLE_SENSE_ENABLED, 1250421, ViBoolean, SESSION, 0, 0, 1, HSDIG_ATTR_READ_ONLY) \
  /* Instrument */ \
  X(PRIVILEGE_LEVEL, 1250501, ViInt32, SESSION, 3, 0, 3, HSDIG_ATTR_READ_ONLY) \
  X(MODEL, 1250502, ViString, SESSION, "HSD-4", 0, 0, HSDIG_ATTR_READ_ONLY) \
  X(SERIAL_NUMBER, 1250503, ViString, SESSION, "", 0, 0, HSDIG_ATTR_READ_ONLY) \
  X(RESOLUTION, 1250504, ViInt32, SESSION, 14, 8, 16, HSDIG_ATTR_READ_ONLY)         /* ADC bits */ \
  X(MAX_SAMPLE_RATE, 1250505, ViReal64, SESSION, 250.0e6, 0.0, 1.0e10, HSDIG_ATTR_READ_ONLY) \
  X(BANDWIDTH, 1250506, ViReal64, SESSION, 100.0e6, 0.0, 1.0e10, HSDIG_ATTR_READ_ONLY) \
  X(DEVICE_TEMPERATURE, 1250507, ViReal64, SESSION, 35.0, -100.0, 200.0, HSDIG_ATTR_READ_ONLY) /* degrees Celsius */ \
  X(LAST_CAL_TEMPERATURE, 1250508, ViReal64, CHANNEL, 35.0, -100.0, 200.0, HSDIG_ATTR_READ_ONLY) \
  X(REFERENCE_SESSION, 1250509, ViSession, SESSION, 0, 0, 4294967295.0, 0)          /* a session this one follows */ \
  X(FETCH_RELATIVE_TO, 1250510, ViInt32, SESSION, 0, 0, 1, 0)                       /* HSDIG_VAL_..._RELATIVE */ \
  X(FETCH_OFFSET, 1250511, ViInt64, SESSION, 0, -67108864, 67108864, 0)             /* samples */
/* clang-format on */

#define HSDIG_ATTRIBUTE_ID(NAME, id, type, scope, def, min, max, flags) HSDIG_ATTR_##NAME = id,
enum hsdigAttributeId { HSDIG_ATTRIBUTES(HSDIG_ATTRIBUTE_ID) };
#undef HSDIG_ATTRIBUTE_ID

/* ---- Values of the attributes above ---- */
/* VERTICAL_COUPLING */
#define HSDIG_VAL_AC 0
#define HSDIG_VAL_DC 1
#define HSDIG_VAL_GND 2
/* SIGNAL_SHAPE */
#define HSDIG_VAL_SHAPE_DC 0 /* SIGNAL_OFFSET only */
#define HSDIG_VAL_SHAPE_SINE 1
#define HSDIG_VAL_SHAPE_SQUARE 2
#define HSDIG_VAL_SHAPE_TRIANGLE 3
#define HSDIG_VAL_SHAPE_SAWTOOTH 4 /* rising ramp */
/* ACQUISITION_TYPE (ConfigureAcquisition) */
#define HSDIG_VAL_NORMAL 0
#define HSDIG_VAL_FLEXRES 1
#define HSDIG_VAL_DDC 2
/* SAMPLE_MODE (SampleMode) */
#define HSDIG_VAL_REAL_TIME 0
#define HSDIG_VAL_EQUIVALENT_TIME 1
/* TRIGGER_TYPE */
#define HSDIG_VAL_EDGE_TRIGGER 1
#define HSDIG_VAL_HYSTERESIS_TRIGGER 2
#define HSDIG_VAL_DIGITAL_TRIGGER 3
#define HSDIG_VAL_WINDOW_TRIGGER 4
#define HSDIG_VAL_SOFTWARE_TRIGGER 5
#define HSDIG_VAL_IMMEDIATE_TRIGGER 6
#define HSDIG_VAL_WIDTH_TRIGGER 7
#define HSDIG_VAL_RUNT_TRIGGER 8
#define HSDIG_VAL_GLITCH_TRIGGER 9
#define HSDIG_VAL_VIDEO_TRIGGER 10
/* TRIGGER_SLOPE */
#define HSDIG_VAL_NEGATIVE 0
#define HSDIG_VAL_POSITIVE 1
/* TRIGGER_COUPLING */
#define HSDIG_VAL_TRIGGER_COUPLING_AC 0
#define HSDIG_VAL_TRIGGER_COUPLING_DC 1
#define HSDIG_VAL_TRIGGER_COUPLING_HF_REJECT 2
#define HSDIG_VAL_TRIGGER_COUPLING_LF_REJECT 3
#define HSDIG_VAL_TRIGGER_COUPLING_AC_PLUS_HF_REJECT 4
/* TRIGGER_WINDOW_MODE */
#define HSDIG_VAL_ENTERING_WINDOW 0
#define HSDIG_VAL_LEAVING_WINDOW 1
/* TRIGGER_POLARITY (width, runt, glitch, video) */
#define HSDIG_VAL_POLARITY_POSITIVE 0
#define HSDIG_VAL_POLARITY_NEGATIVE 1
#define HSDIG_VAL_POLARITY_EITHER 2
/* TRIGGER_WIDTH_CONDITION */
#define HSDIG_VAL_WITHIN 0
#define HSDIG_VAL_OUTSIDE 1
/* TRIGGER_GLITCH_CONDITION */
#define HSDIG_VAL_LESS_THAN 0
#define HSDIG_VAL_GREATER_THAN 1
/* TRIGGER_VIDEO_FORMAT */
#define HSDIG_VAL_NTSC 0
#define HSDIG_VAL_PAL 1
#define HSDIG_VAL_SECAM 2
#define HSDIG_VAL_M_PAL 3
/* TRIGGER_VIDEO_EVENT */
#define HSDIG_VAL_VIDEO_ANY_FIELD 0
#define HSDIG_VAL_VIDEO_FIELD1 1
#define HSDIG_VAL_VIDEO_FIELD2 2
#define HSDIG_VAL_VIDEO_ANY_LINE 3
#define HSDIG_VAL_VIDEO_LINE_NUMBER 4
/* FETCH_RELATIVE_TO */
#define HSDIG_VAL_START_RELATIVE 0
#define HSDIG_VAL_TRIGGER_RELATIVE 1

/* ExportSignal's signal; each has an EXPORTED_..._TERMINAL attribute.
 * Terminals: "None", "PFI0", "PFI1", "ClkOut", "Trig0" to "Trig7". */
#define HSDIG_VAL_REF_CLOCK 0
#define HSDIG_VAL_START_TRIGGER 1
#define HSDIG_VAL_REF_TRIGGER 2
#define HSDIG_VAL_END_OF_RECORD_EVENT 3
#define HSDIG_VAL_READY_FOR_START_EVENT 4

/* SendSoftwareTriggerEdge's whichTrigger */
#define HSDIG_VAL_SOFTWARE_TRIGGER_START 0
#define HSDIG_VAL_SOFTWARE_TRIGGER_REFERENCE 1
#define HSDIG_VAL_SOFTWARE_TRIGGER_ADVANCE 2
#define HSDIG_VAL_SOFTWARE_TRIGGER_ARM_REFERENCE 3

/* AcquisitionStatus */
#define HSDIG_VAL_ACQ_IN_PROGRESS 0
#define HSDIG_VAL_ACQ_COMPLETE 1
#define HSDIG_VAL_ACQ_STATUS_UNKNOWN (-1)

/* GetSessionState */
#define HSDIG_VAL_STATE_IDLE 0      /* configuring */
#define HSDIG_VAL_STATE_COMMITTED 1 /* configuration applied, not acquiring */
#define HSDIG_VAL_STATE_ACQUIRING 2 /* initiated, waiting for the trigger or the records */
#define HSDIG_VAL_STATE_COMPLETE 3  /* the last acquisition holds data */
#define HSDIG_VAL_STATE_DISABLED 4  /* the channel named is disabled */

/* GetAttributeWithOptions... retrievalMode */
#define HSDIG_VAL_RETRIEVE_CURRENT 0
#define HSDIG_VAL_RETRIEVE_DEFAULT 1
#define HSDIG_VAL_RETRIEVE_MIN 2
#define HSDIG_VAL_RETRIEVE_MAX 3

/* RequestPrivilege */
#define HSDIG_VAL_PRIVILEGE_NONE 0
#define HSDIG_VAL_PRIVILEGE_OBSERVE 1
#define HSDIG_VAL_PRIVILEGE_CONFIGURE 2
#define HSDIG_VAL_PRIVILEGE_CONTROL 3

/* CalSelfCalibrate option */
#define HSDIG_VAL_CAL_NORMAL 0
#define HSDIG_VAL_CAL_RESTRICTED 1

/* CachedFetch dataType: the sample formats and their element sizes. */
#define HSDIG_VAL_BINARY8 1             /* ViInt8 */
#define HSDIG_VAL_BINARY16 2            /* ViInt16 */
#define HSDIG_VAL_BINARY32 4            /* ViInt32 */
#define HSDIG_VAL_REAL64 8              /* ViReal64 volts */
#define HSDIG_VAL_COMPLEX_BINARY8 1000  /* ViInt8 pair */
#define HSDIG_VAL_COMPLEX_BINARY16 1001 /* ViInt16 pair */
#define HSDIG_VAL_COMPLEX_BINARY32 1002 /* ViInt32 pair */
#define HSDIG_VAL_COMPLEX_REAL64 1003   /* ViReal64 pair */

/* ---- Registers (ReadRegister, WriteRegister) ----
 * A 4096-byte register file; size is 1, 2 or 4 bytes, the offset a multiple
 * of the size. The first 16 bytes are read-only. */
#define HSDIG_REG_ID 0x000       /* "HSDG" (0x48534447) */
#define HSDIG_REG_REVISION 0x004 /* firmware revision, 0x00030201 */
#define HSDIG_REG_CHANNELS 0x008 /* channel count of the model */
#define HSDIG_REG_STATUS 0x00C   /* bit 0 acquiring, bit 1 complete */
#define HSDIG_REG_SCRATCH 0x010  /* first writable register */
#define HSDIG_REG_FILE_SIZE 4096

/* ---- Measurement functions ---- */
/* Scalar (FetchMeasurement, ReadMeasurement, FetchMeasurementStats,
 * ClearWaveformMeasurementStats). Levels are 10/50/90 % between the
 * waveform's low and high (the most common values near its minimum and
 * maximum). */
#define HSDIG_SCALAR_MEASUREMENTS(X)  \
  X(RISE_TIME, 0)            /* s */  \
  X(FALL_TIME, 1)            /* s */  \
  X(FREQUENCY, 2)            /* Hz */ \
  X(PERIOD, 3)               /* s */  \
  X(VOLTAGE_RMS, 4)          /* V */  \
  X(VOLTAGE_PEAK_TO_PEAK, 5) /* V */  \
  X(VOLTAGE_MAX, 6)          /* V */  \
  X(VOLTAGE_MIN, 7)          /* V */  \
  X(VOLTAGE_HIGH, 8)         /* V */  \
  X(VOLTAGE_LOW, 9)          /* V */  \
  X(VOLTAGE_AVERAGE, 10)     /* V */  \
  X(WIDTH_NEG, 11)           /* s */  \
  X(WIDTH_POS, 12)           /* s */  \
  X(DUTY_CYCLE_NEG, 13)      /* % */  \
  X(DUTY_CYCLE_POS, 14)      /* % */  \
  X(AMPLITUDE, 15)           /* V */
#define HSDIG_MEAS_ID(NAME, id) HSDIG_MEAS_##NAME = id,
enum hsdigScalarMeasurement { HSDIG_SCALAR_MEASUREMENTS(HSDIG_MEAS_ID) };
/* ClearWaveformMeasurementStats: every scalar function at once. */
#define HSDIG_MEAS_ALL_MEASUREMENTS 10000

/* Array (FetchArrayMeasurement, ActualMeasWfmSize, AddWaveformProcessing).
 * Time-domain functions keep the record length and x increment; the FFT
 * spectra have 2^k / 2 + 1 points (2^k the record length rounded up to a
 * power of two, zero padded), start at 0 Hz and step sampleRate / 2^k. */
#define HSDIG_ARRAY_MEASUREMENTS(X)                                      \
  X(ARRAY_NONE, 1000)                 /* the scaled waveform itself */   \
  X(ARRAY_NEGATE, 1001)               /* -v */                           \
  X(ARRAY_ABSOLUTE, 1002)             /* |v| */                          \
  X(ARRAY_SQUARE, 1003)               /* v^2 */                          \
  X(ARRAY_DC_REMOVE, 1004)            /* v - mean */                     \
  X(ARRAY_DERIVATIVE, 1005)           /* dv/dt, central differences */   \
  X(ARRAY_INTEGRAL, 1006)             /* running trapezoidal integral */ \
  X(FFT_AMP_SPECTRUM_VOLTS_RMS, 1007) /* V RMS per bin */                \
  X(FFT_AMP_SPECTRUM_DB, 1008)        /* dB relative to 1 V RMS */
enum hsdigArrayMeasurement { HSDIG_ARRAY_MEASUREMENTS(HSDIG_MEAS_ID) };
#undef HSDIG_MEAS_ID

#endif /* HSDIG_ATTRIBUTES_H */
