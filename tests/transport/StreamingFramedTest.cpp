// The streaming framed transport against the library's framed transport:
// the same bytes on the wire, the same values read back, whatever the pieces
// the stream arrives in.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

#include <thrift/protocol/TBinaryProtocol.h>
#include <thrift/transport/TBufferTransports.h>
#include <thrift/transport/TTransportException.h>
#include <thrift/transport/TVirtualTransport.h>

#include "contract/TransportConfiguration.h"
#include "transport/TStreamingFramedTransport.h"

namespace hsdig::transport {
namespace {

using apache::thrift::protocol::TBinaryProtocol;
using apache::thrift::transport::TFramedTransport;
using apache::thrift::transport::TTransportException;

// A stream in memory that hands out at most `chunk` bytes per read and keeps
// what is written; it records the length of every read asked for.
class Trickle : public apache::thrift::transport::TVirtualTransport<Trickle> {
 public:
  explicit Trickle(std::string incoming = {}, uint32_t chunk = 1u << 30)
      : incoming_(std::move(incoming)), chunk_(chunk) {}
  bool isOpen() const override { return true; }
  uint32_t read(uint8_t* buf, uint32_t len) {
    asked.push_back(len);
    const auto n = static_cast<uint32_t>(std::min<size_t>({len, chunk_, incoming_.size() - pos_}));
    std::memcpy(buf, incoming_.data() + pos_, n);
    pos_ += n;
    return n;
  }
  void write(const uint8_t* buf, uint32_t len) {
    written.append(reinterpret_cast<const char*>(buf), len);
    ++writes;
  }
  std::string written;
  int writes = 0;
  std::vector<uint32_t> asked;

 private:
  std::string incoming_;
  size_t pos_ = 0;
  uint32_t chunk_;
};

// One message: a name, a large string and a number, as a reply carries them.
void writeMessage(apache::thrift::protocol::TProtocol& out, const std::string& big, int32_t n) {
  out.writeMessageBegin("omniReadOrFetch", apache::thrift::protocol::T_REPLY, n);
  out.writeStructBegin("r");
  out.writeFieldBegin("wfmData", apache::thrift::protocol::T_STRING, 1);
  out.writeString(big);
  out.writeFieldEnd();
  out.writeFieldBegin("numRecords", apache::thrift::protocol::T_I32, 2);
  out.writeI32(n);
  out.writeFieldEnd();
  out.writeFieldStop();
  out.writeStructEnd();
  out.writeMessageEnd();
  out.getTransport()->writeEnd();
  out.getTransport()->flush();
}

void readMessage(apache::thrift::protocol::TProtocol& in, std::string& big, int32_t& n) {
  std::string name;
  apache::thrift::protocol::TMessageType type;
  int32_t seqid = 0;
  in.readMessageBegin(name, type, seqid);
  std::string ignored;
  in.readStructBegin(ignored);
  apache::thrift::protocol::TType fieldType;
  int16_t id = 0;
  in.readFieldBegin(ignored, fieldType, id);
  in.readString(big);
  in.readFieldEnd();
  in.readFieldBegin(ignored, fieldType, id);
  in.readI32(n);
  in.readFieldEnd();
  in.readFieldBegin(ignored, fieldType, id);
  EXPECT_EQ(fieldType, apache::thrift::protocol::T_STOP);
  in.readStructEnd();
  in.readMessageEnd();
  EXPECT_EQ(name, "omniReadOrFetch");
  EXPECT_EQ(seqid, n);
}

std::string pattern(size_t size, char seed) {
  std::string s(size, '\0');
  for (size_t i = 0; i < size; ++i) s[i] = static_cast<char>(seed + i * 7 % 251);
  return s;
}

// Bytes of writeMessage besides the large string: message header 27, string
// field header and length 7, number field 7, stop 1.
constexpr size_t kMessageOverhead = 42;

const std::vector<size_t> kSizes = {0, 1, TStreamingFramedTransport::kDirectSize - 1,
                                    TStreamingFramedTransport::kDirectSize, 300 * 1024};

// What the library's framed transport puts on the wire for these messages.
std::string libraryBytes(const std::vector<std::string>& bigs) {
  auto sink = std::make_shared<Trickle>();
  auto framed = std::make_shared<TFramedTransport>(sink, contract::makeTransportConfiguration());
  TBinaryProtocol out(framed);
  for (size_t i = 0; i < bigs.size(); ++i) writeMessage(out, bigs[i], static_cast<int32_t>(i));
  return sink->written;
}

TEST(StreamingFramedTest, WritesTheLibrarysBytesWithAndWithoutDirectWrites) {
  std::vector<std::string> bigs;
  for (size_t i = 0; i < kSizes.size(); ++i) bigs.push_back(pattern(kSizes[i], 'a' + i));
  const std::string expected = libraryBytes(bigs);
  for (auto mode : {TStreamingFramedTransport::DirectWrites::kOff,
                    TStreamingFramedTransport::DirectWrites::kOn}) {
    auto sink = std::make_shared<Trickle>();
    auto framed = std::make_shared<TStreamingFramedTransport>(
        sink, contract::makeTransportConfiguration(), mode);
    TBinaryProtocol out(framed);
    for (size_t i = 0; i < bigs.size(); ++i) {
      writeMessage(out, bigs[i], static_cast<int32_t>(i));
      EXPECT_EQ(framed->takeLastFlushedFrameBytes(), 4 + kMessageOverhead + bigs[i].size());
    }
    EXPECT_EQ(sink->written, expected);
  }
}

TEST(StreamingFramedTest, DirectWritesSendTheCallersBytesAndCanBeDiscarded) {
  auto sink = std::make_shared<Trickle>();
  auto framed = std::make_shared<TStreamingFramedTransport>(
      sink, contract::makeTransportConfiguration(), TStreamingFramedTransport::DirectWrites::kOn);
  // A large write is referenced, not copied: a change before the flush is
  // what goes out.
  std::string big(TStreamingFramedTransport::kDirectSize, 'x');
  framed->write(reinterpret_cast<const uint8_t*>("ab"), 2);
  framed->write(reinterpret_cast<const uint8_t*>(big.data()), static_cast<uint32_t>(big.size()));
  framed->write(reinterpret_cast<const uint8_t*>("cd"), 2);
  EXPECT_EQ(framed->writeEnd(), 4 + 2 + big.size() + 2);
  big[0] = 'y';
  framed->flush();
  EXPECT_EQ(sink->writes, 3);
  ASSERT_EQ(sink->written.size(), 4 + 2 + big.size() + 2);
  EXPECT_EQ(sink->written.substr(0, 7), std::string("\0\1\0\4aby", 7));
  EXPECT_EQ(sink->written.substr(sink->written.size() - 2), "cd");

  // An abandoned message leaves nothing behind, not even its references.
  sink->written.clear();
  framed->write(reinterpret_cast<const uint8_t*>(big.data()), static_cast<uint32_t>(big.size()));
  framed->discardWrite();
  big.clear();
  big.shrink_to_fit();
  framed->write(reinterpret_cast<const uint8_t*>("ok"), 2);
  framed->flush();
  EXPECT_EQ(sink->written, std::string("\0\0\0\2ok", 6));
}

TEST(StreamingFramedTest, ReadsEveryMessageWhateverPiecesTheStreamArrivesIn) {
  std::vector<std::string> bigs;
  for (size_t i = 0; i < kSizes.size(); ++i) bigs.push_back(pattern(kSizes[i], 'A' + i));
  const std::string stream = libraryBytes(bigs);
  for (uint32_t chunk : {1u, 3u, 4u, 5u, 1000u, 16384u, 70000u, 1u << 30}) {
    SCOPED_TRACE("chunk " + std::to_string(chunk));
    auto source = std::make_shared<Trickle>(stream, chunk);
    auto framed =
        std::make_shared<TStreamingFramedTransport>(source, contract::makeTransportConfiguration());
    TBinaryProtocol in(framed);
    for (size_t i = 0; i < bigs.size(); ++i) {
      std::string big;
      int32_t n = -1;
      readMessage(in, big, n);
      EXPECT_EQ(framed->readEnd(), 4 + kMessageOverhead + bigs[i].size());
      EXPECT_EQ(n, static_cast<int32_t>(i));
      EXPECT_TRUE(big == bigs[i]) << "message " << i;
    }
    // The end of the stream between frames reads as nothing.
    uint8_t byte;
    EXPECT_EQ(framed->read(&byte, 1), 0u);
  }
}

TEST(StreamingFramedTest, LargeStringsAreReadStraightIntoTheirDestination) {
  const std::string big = pattern(1 << 20, 'q');
  auto source = std::make_shared<Trickle>(libraryBytes({big}));
  auto framed =
      std::make_shared<TStreamingFramedTransport>(source, contract::makeTransportConfiguration());
  TBinaryProtocol in(framed);
  std::string got;
  int32_t n = -1;
  readMessage(in, got, n);
  EXPECT_TRUE(got == big);
  // One read-ahead fill (frame length, message header, string length and
  // the string's first bytes), the rest of the string in one read straight
  // into it, then one fill for the tail.
  const uint32_t inFirstFill = TStreamingFramedTransport::kReadAheadSize - 4 - 27 - 7;
  ASSERT_EQ(source->asked.size(), 3u);
  EXPECT_EQ(source->asked[0], TStreamingFramedTransport::kReadAheadSize);
  EXPECT_EQ(source->asked[1], big.size() - inFirstFill);
  EXPECT_EQ(source->asked[2], TStreamingFramedTransport::kReadAheadSize);
}

TEST(StreamingFramedTest, RefusesBadFramesWithTheLibrarysTexts) {
  struct Case {
    std::string stream;
    TTransportException::TTransportExceptionType type;
    const char* text;
  };
  const Case cases[] = {
      {std::string("\x80\0\0\0", 4), TTransportException::UNKNOWN, "Frame size has negative value"},
      {std::string("\x10\0\0\1", 4), TTransportException::CORRUPTED_DATA,
       "Received an oversized frame"},
      {std::string("\0\0", 2), TTransportException::END_OF_FILE,
       "No more data to read after partial frame header."},
      {std::string("\0\0\0\x08"
                   "ab",
                   6),
       TTransportException::END_OF_FILE, "No more data to read."},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.text);
    auto framed = std::make_shared<TStreamingFramedTransport>(
        std::make_shared<Trickle>(c.stream, 1), contract::makeTransportConfiguration());
    uint8_t buffer[8];
    try {
      framed->readAll(buffer, 8);
      ADD_FAILURE() << "no exception";
    } catch (const TTransportException& e) {
      EXPECT_EQ(e.getType(), c.type);
      EXPECT_STREQ(e.what(), c.text);
    }
  }
}

}  // namespace
}  // namespace hsdig::transport
