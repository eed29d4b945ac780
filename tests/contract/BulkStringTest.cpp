// The bulk-string protocol reads what the contract's binary protocol wrote,
// whether a string is small, large and new, or large into a string that
// already has the room.
#include <gtest/gtest.h>

#include <string>

#include <thrift/protocol/TBinaryProtocol.h>
#include <thrift/transport/TBufferTransports.h>

#include "contract/TBulkStringBinaryProtocol.h"
#include "contract/TransportConfiguration.h"

namespace hsdig::contract {
namespace {

TEST(BulkStringTest, ReadsSmallLargeAndReusedStringsAsWritten) {
  auto buffer =
      std::make_shared<apache::thrift::transport::TMemoryBuffer>(makeTransportConfiguration());
  auto writer = makeProtocolFactory()->getProtocol(buffer);
  std::string large(TBulkStringBinaryProtocol::kBulkStringSize + 12345, '\0');
  for (size_t i = 0; i < large.size(); ++i) large[i] = static_cast<char>(i * 31 % 253);
  writer->writeString("small");
  writer->writeString(large);
  writer->writeBinary(large);
  writer->writeString("");
  writer->writeI32(42);

  // Read as generated code reads: through the protocol interface.
  TBulkStringBinaryProtocol bulk(buffer);
  apache::thrift::protocol::TProtocol& reader = bulk;
  std::string small, first, second = "x", empty = "not empty";
  reader.readString(small);
  reader.readString(first);
  second.reserve(large.size());  // room enough: read in place
  reader.readBinary(second);
  reader.readString(empty);
  int32_t tail = 0;
  reader.readI32(tail);
  EXPECT_EQ(small, "small");
  EXPECT_TRUE(first == large);
  EXPECT_TRUE(second == large);
  EXPECT_EQ(empty, "");
  EXPECT_EQ(tail, 42);
}

TEST(BulkStringTest, ALengthPastTheDataFailsWithoutKeepingAPartialString) {
  auto buffer =
      std::make_shared<apache::thrift::transport::TMemoryBuffer>(makeTransportConfiguration());
  auto writer = makeProtocolFactory()->getProtocol(buffer);
  writer->writeI32(TBulkStringBinaryProtocol::kBulkStringSize);
  writer->writeI32(7);  // far fewer bytes than announced
  TBulkStringBinaryProtocol reader(buffer);
  std::string text = "before";
  EXPECT_THROW(reader.readString(text), apache::thrift::transport::TTransportException);
  EXPECT_TRUE(text == "before") << "changed to " << text.size() << " bytes";
}

}  // namespace
}  // namespace hsdig::contract
