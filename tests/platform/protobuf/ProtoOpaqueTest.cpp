#include "platform/protobuf/ProtoOpaque.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class OtherOpaque final : public ProtoOpaque {};

std::shared_ptr<ProtoOpaque> opaque(std::vector<std::uint8_t> bytes) {
    auto message = std::make_shared<ProtoOpaque>();
    message->setBytes(std::move(bytes));
    return message;
}

TEST(ProtoOpaque, CarriesItsBytesThroughUnchanged) {
    const std::vector<std::uint8_t> bytes{0xff, 0x00, 0x06, 0x07};
    const auto message = protoMessageWithBytes<ProtoOpaque>(bytes);
    ASSERT_TRUE(message);
    ProtoWriter writer;
    message->writeTo(writer);
    EXPECT_EQ(writer.bytes(), bytes);
}

TEST(ProtoOpaque, EqualsTheSameBytesOfTheSameClassOnly) {
    EXPECT_TRUE(equal(opaque({1, 2}), opaque({1, 2})));
    EXPECT_EQ(opaque({1, 2})->hash(), opaque({1, 2})->hash());
    EXPECT_FALSE(equal(opaque({1, 2}), opaque({1})));
    EXPECT_FALSE(equal(opaque({}), std::make_shared<OtherOpaque>()));
    EXPECT_FALSE(equal(std::make_shared<OtherOpaque>(), opaque({})));
}

TEST(ProtoOpaque, MergingAppendsAndMayBeWithItself) {
    const auto message = opaque({1});
    message->mergeFrom(*opaque({2}));
    message->mergeFrom(*message);
    EXPECT_EQ(message->bytes(), (std::vector<std::uint8_t>{1, 2, 1, 2}));
}

TEST(ProtoOpaque, CopyIsIndependent) {
    const auto message = opaque({1});
    const auto copy = std::dynamic_pointer_cast<ProtoOpaque>(message->copy());
    message->setBytes({2});
    EXPECT_EQ(copy->bytes(), (std::vector<std::uint8_t>{1}));
}

} // namespace
} // namespace orvo
