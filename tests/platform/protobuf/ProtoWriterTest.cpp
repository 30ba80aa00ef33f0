#include "platform/protobuf/ProtoWriter.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Bytes = std::vector<std::uint8_t>;

TEST(ProtoWriter, WritesVarintsInAsFewBytesAsTheyNeed) {
    ProtoWriter writer;
    writer.writeUInt64(1, 0);
    writer.writeUInt64(1, 127);
    writer.writeUInt64(1, 128);
    EXPECT_EQ(writer.bytes(), (Bytes{0x08, 0, 0x08, 0x7f, 0x08, 0x80, 0x01}));
}

TEST(ProtoWriter, WritesANegativeInt32AsTenBytes) {
    ProtoWriter writer;
    writer.writeInt32(2, -1);
    EXPECT_EQ(writer.bytes(),
              (Bytes{0x10, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0x01}));
}

TEST(ProtoWriter, WritesDoublesLittleEndian) {
    ProtoWriter writer;
    writer.writeDouble(17, 1.0);
    EXPECT_EQ(writer.bytes(), (Bytes{0x89, 0x01, 0, 0, 0, 0, 0, 0, 0xf0, 0x3f}));
}

TEST(ProtoWriter, WritesTextAndBytesWithTheirLength) {
    ProtoWriter writer;
    writer.writeString(1, "é");
    writer.writeBytes(2, {});
    EXPECT_EQ(writer.bytes(), (Bytes{0x0a, 2, 0xc3, 0xa9, 0x12, 0}));
}

} // namespace
} // namespace orvo
