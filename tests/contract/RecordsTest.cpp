// Encoding rules of the contract's records: presence flags, defaults, skipping
// of unknown or mistyped fields, the nesting limit, and byte-exact details.
#include <gtest/gtest.h>

#include <sstream>

#include <thrift/Thrift.h>
#include <thrift/protocol/TProtocolException.h>

#include "hsdig_types.h"
#include "support/Wire.h"

namespace hsdig {
namespace {

using apache::thrift::protocol::TProtocol;
using apache::thrift::protocol::TProtocolException;
using apache::thrift::protocol::TType;
using test::deserialize;
using test::MemoryWire;
using test::serialize;

TEST(Records, RoundTripKeepsValuesAndSetsEveryPresenceFlag) {
  RetStatus status;
  status.code = -1074097790;
  status.localizedTextDescription =
      "session \xE2\x80\x9C"
      "A\x00"
      "B\xE2\x80\x9D";

  {
    SCOPED_TRACE("RetStatus");
    auto back = deserialize<RetStatus>(serialize(status));
    EXPECT_EQ(back, status);
    EXPECT_TRUE(back.__isset.code && back.__isset.localizedTextDescription);
  }
  {
    SCOPED_TRACE("RetRegisterClientSession");
    RetRegisterClientSession r;
    r.status = status;
    r.clientID = 7;
    r.stolenClientID = 3;
    auto back = deserialize<RetRegisterClientSession>(serialize(r));
    EXPECT_EQ(back, r);
    EXPECT_TRUE(back.__isset.status && back.__isset.clientID && back.__isset.stolenClientID);
  }
  {
    SCOPED_TRACE("RetWfmRecords with TypeWfmInfo");
    RetWfmRecords r;
    r.status = status;
    r.numRecords = 2;
    r.numPoints = 3;
    for (int i = 0; i < 2; ++i) {
      TypeWfmInfo info;
      info.actualSamples = 3;
      info.absoluteInitialX = 1.5e-3 * i;
      info.relativeInitialX = -2e-9;
      info.xIncrement = 1e-9;
      info.offset = 0.25;
      info.gain = 1.0 / 127;
      info.reserved1 = i;
      info.reserved2 = -i;
      r.wfmInfoList.push_back(info);
    }
    r.wfmData = std::string("\x00\x01\x7f\x80\xff\x00", 6);
    auto back = deserialize<RetWfmRecords>(serialize(r));
    EXPECT_EQ(back, r);
    EXPECT_TRUE(back.__isset.wfmInfoList && back.__isset.wfmData && back.__isset.numPoints);
    EXPECT_TRUE(back.wfmInfoList[1].__isset.reserved2);
  }
  {
    SCOPED_TRACE("RetRevisionQuery, RetSelfTest");
    RetRevisionQuery rq;
    rq.status = status;
    rq.driverRev = "1.2";
    rq.instrRev = "A";
    EXPECT_EQ(deserialize<RetRevisionQuery>(serialize(rq)), rq);
    RetSelfTest st;
    st.testResult = -3;
    st.testMessage = "fan";
    auto back = deserialize<RetSelfTest>(serialize(st));
    EXPECT_EQ(back, st);
    EXPECT_TRUE(back.__isset.testResult);
  }
  {
    SCOPED_TRACE("RetCoefficients with CoefficientInfo");
    RetCoefficients rc;
    rc.numberOfCoefficientSets = 1;
    CoefficientInfo ci;
    ci.offset = -0.5;
    ci.gain = 2;
    rc.coefficientInfoList.push_back(ci);
    EXPECT_EQ(deserialize<RetCoefficients>(serialize(rc)), rc);
  }
  {
    SCOPED_TRACE("Nulls_ and Ret_ families");
    Nulls_hsdig_FetchMeasurementStats nulls;
    nulls.channelList = true;
    nulls.numInStats = true;
    auto nullsBack = deserialize<Nulls_hsdig_FetchMeasurementStats>(serialize(nulls));
    EXPECT_EQ(nullsBack, nulls);
    EXPECT_TRUE(nullsBack.__isset.mean);

    Ret_hsdig_GetAttributeViString s;
    s.status = status;
    s.value = {'a', 'b', 0, 'z'};
    s.returnSizeOnNullArray = 42;
    auto sBack = deserialize<Ret_hsdig_GetAttributeViString>(serialize(s));
    EXPECT_EQ(sBack, s);
    EXPECT_TRUE(sBack.__isset.value && sBack.__isset.returnSizeOnNullArray);
  }
}

// Writes a record by hand, field by field, so tests can send what a
// well-behaved writer never would.
class HandWriter {
 public:
  HandWriter() { wire_.protocol->writeStructBegin("X"); }
  TProtocol& out() { return *wire_.protocol; }
  std::string finish() {
    wire_.protocol->writeFieldStop();
    wire_.protocol->writeStructEnd();
    return wire_.bytes();
  }

 private:
  MemoryWire wire_;
};

TEST(Records, MissingFieldsKeepDefaultsWithClearFlags) {
  HandWriter w;
  w.out().writeFieldBegin("code", apache::thrift::protocol::T_I32, 1);
  w.out().writeI32(-5);
  auto back = deserialize<RetStatus>(w.finish());
  EXPECT_EQ(back.code, -5);
  EXPECT_TRUE(back.__isset.code);
  EXPECT_EQ(back.localizedTextDescription, "");
  EXPECT_FALSE(back.__isset.localizedTextDescription);
}

TEST(Records, FieldOfTheRightIdButWrongTypeIsSkipped) {
  {
    SCOPED_TRACE("RetStatus.code sent as a string");
    HandWriter w;
    w.out().writeFieldBegin("code", apache::thrift::protocol::T_STRING, 1);
    w.out().writeString("-5");
    w.out().writeFieldBegin("localizedTextDescription", apache::thrift::protocol::T_STRING, 2);
    w.out().writeString("after");
    auto back = deserialize<RetStatus>(w.finish());
    EXPECT_EQ(back.code, 0);
    EXPECT_FALSE(back.__isset.code);
    EXPECT_EQ(back.localizedTextDescription, "after");
  }
  {
    SCOPED_TRACE("a driver boolean sent as bool instead of i16");
    HandWriter w;
    w.out().writeFieldBegin("value", apache::thrift::protocol::T_BOOL, 2);
    w.out().writeBool(true);
    auto back = deserialize<Ret_hsdig_GetAttributeViBoolean>(w.finish());
    EXPECT_EQ(back.value, 0);
    EXPECT_FALSE(back.__isset.value);
  }
  {
    SCOPED_TRACE("a driver boolean travels as i16 1");
    Ret_hsdig_GetAttributeViBoolean b;
    b.value = 1;
    std::string bytes = serialize(b);
    // Field 2: type byte 6 (i16), id 0x0002, value 0x0001.
    EXPECT_NE(bytes.find(std::string("\x06\x00\x02\x00\x01", 5)), std::string::npos);
  }
}

TEST(Records, UnknownFieldsOfEveryShapeAreSkipped) {
  HandWriter w;
  auto& out = w.out();
  out.writeFieldBegin("u1", apache::thrift::protocol::T_STRUCT, 40);
  out.writeStructBegin("Nested");
  out.writeFieldBegin("inner", apache::thrift::protocol::T_LIST, 1);
  out.writeListBegin(apache::thrift::protocol::T_STRUCT, 2);
  for (int i = 0; i < 2; ++i) {
    out.writeStructBegin("E");
    out.writeFieldBegin("d", apache::thrift::protocol::T_DOUBLE, 3);
    out.writeDouble(i);
    out.writeFieldStop();
    out.writeStructEnd();
  }
  out.writeListEnd();
  out.writeFieldStop();
  out.writeStructEnd();
  out.writeFieldBegin("u2", apache::thrift::protocol::T_MAP, 41);
  out.writeMapBegin(apache::thrift::protocol::T_STRING, apache::thrift::protocol::T_I64, 1);
  out.writeString("k");
  out.writeI64(9);
  out.writeMapEnd();
  out.writeFieldBegin("clientID", apache::thrift::protocol::T_I32, 2);
  out.writeI32(77);
  out.writeFieldBegin("u3", apache::thrift::protocol::T_STRING, -3);
  out.writeString("negative id");
  auto back = deserialize<RetRegisterClientSession>(w.finish());
  EXPECT_EQ(back.clientID, 77);
  EXPECT_TRUE(back.__isset.clientID);
  EXPECT_FALSE(back.__isset.status);
  EXPECT_FALSE(back.__isset.stolenClientID);
}

TEST(Records, NestingBeyondTheDepthLimitFailsWithTheDepthLimitKind) {
  auto nestedUnknown = [](int depth) {
    HandWriter w;
    auto& out = w.out();
    for (int i = 0; i < depth; ++i) {
      out.writeFieldBegin("n", apache::thrift::protocol::T_STRUCT, 99);
      out.writeStructBegin("N");
    }
    for (int i = 0; i < depth; ++i) {
      out.writeFieldStop();
      out.writeStructEnd();
    }
    return w.finish();
  };
  // The record itself is one level; 62 nested levels below it stay within 64.
  EXPECT_NO_THROW(deserialize<RetStatus>(nestedUnknown(62)));
  try {
    deserialize<RetStatus>(nestedUnknown(80));
    FAIL() << "no exception";
  } catch (const TProtocolException& e) {
    EXPECT_EQ(e.getType(), TProtocolException::DEPTH_LIMIT);
  }
}

TEST(Records, EmptyListsAreAHeaderWithCountZero) {
  struct Case {
    const char* name;
    std::string bytes;
    int8_t fieldType;
    int16_t fieldId;
    int8_t elementType;
  };
  Ret_hsdig_GetAttributeViString emptyString;
  const Case cases[] = {
      {"wfmInfoList", serialize(RetWfmRecords()), 15, 4, 12},
      {"coefficientInfoList", serialize(RetCoefficients()), 15, 2, 12},
      {"string getter value", serialize(emptyString), 15, 2, 3},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    std::string header{static_cast<char>(c.fieldType),
                       0,
                       static_cast<char>(c.fieldId),
                       static_cast<char>(c.elementType),
                       0,
                       0,
                       0,
                       0};
    EXPECT_NE(c.bytes.find(header), std::string::npos);
  }
}

TEST(Records, WaveformBytesComeBackUnchanged) {
  RetWfmRecords r;
  std::string data(4096, '\0');
  for (size_t i = 0; i < data.size(); i += 3) data[i] = static_cast<char>(i);
  r.wfmData = data;
  EXPECT_EQ(deserialize<RetWfmRecords>(serialize(r)).wfmData, data);
  r.wfmData.clear();
  auto back = deserialize<RetWfmRecords>(serialize(r));
  EXPECT_TRUE(back.__isset.wfmData);
  EXPECT_EQ(back.wfmData, "");
}

TEST(Records, PrintToRendersNameAndFields) {
  RetStatus s;
  s.code = -1074097790;
  s.localizedTextDescription = "no client";
  std::ostringstream text;
  s.printTo(text);
  EXPECT_EQ(text.str(), "RetStatus(code=-1074097790, localizedTextDescription=no client)");

  Nulls_hsdig_GetAttributeViString n;
  n.value = true;
  std::ostringstream ntext;
  n.printTo(ntext);
  EXPECT_EQ(ntext.str(), "Nulls_hsdig_GetAttributeViString(channelList=0, value=1)");
}

TEST(Records, StringsAndListsAreNotCappedBelowTheFrameLimit) {
  // Thrift's stock limits would refuse a 20 MB string; the contract's must not.
  RetWfmRecords r;
  r.wfmData.assign(20 * 1024 * 1024, 'x');
  EXPECT_EQ(deserialize<RetWfmRecords>(serialize(r)).wfmData.size(), r.wfmData.size());
}

}  // namespace
}  // namespace hsdig
