#include "platform/protobuf/ProtoReader.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <memory>
#include <vector>

namespace orvo {
namespace {

using Bytes = std::vector<std::uint8_t>;

/// A reader over a heap block of exactly the given size, so that a sanitizer sees one byte too
/// many.
class Input {
public:
    Input(std::initializer_list<std::uint8_t> bytes)
        : Input(Bytes(bytes)) {}
    explicit Input(const Bytes& bytes)
        : _bytes(std::make_unique<std::uint8_t[]>(bytes.size()))
        , reader({_bytes.get(), bytes.size()}) {
        std::copy(bytes.begin(), bytes.end(), _bytes.get());
    }

private:
    std::unique_ptr<std::uint8_t[]> _bytes;

public:
    ProtoReader reader;
};

TEST(ProtoReader, EmptyInputIsAtEndWithoutError) {
    Input input({});
    EXPECT_TRUE(input.reader.isAtEnd());
    EXPECT_FALSE(input.reader.hasError());
}

TEST(ProtoReader, ReadsVarintsUpToTenBytes) {
    EXPECT_EQ((Input{0x00}.reader.readVarint()), 0U);
    EXPECT_EQ((Input{0xac, 0x02}.reader.readVarint()), 300U);
    Input largest{0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0x01};
    EXPECT_EQ(largest.reader.readVarint(), ~std::uint64_t{0});
    EXPECT_FALSE(largest.reader.hasError());
}

TEST(ProtoReader, VarintOfElevenBytesIsAnError) {
    Input input{0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x80, 0x01};
    input.reader.readVarint();
    EXPECT_TRUE(input.reader.hasError());
}

TEST(ProtoReader, CutOffValuesAreErrorsAtEveryLength) {
    for (const auto& whole : {Bytes{0x80, 0x01}, Bytes{0x03, 'a', 'b', 'c'}}) {
        for (std::size_t length = 0; length < whole.size(); ++length) {
            Input input(Bytes(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)));
            if (whole[0] == 0x80)
                input.reader.readVarint();
            else
                input.reader.readBytes();
            EXPECT_TRUE(input.reader.hasError()) << length;
        }
    }
    for (std::size_t length = 0; length < 8; ++length) {
        Input input(Bytes(length, 1));
        input.reader.readFixed64();
        EXPECT_TRUE(input.reader.hasError()) << length;
    }
    for (std::size_t length = 0; length < 4; ++length) {
        Input input(Bytes(length, 1));
        input.reader.readFixed32();
        EXPECT_TRUE(input.reader.hasError()) << length;
    }
}

TEST(ProtoReader, ReadsFixedWidthsLittleEndian) {
    EXPECT_EQ((Input{1, 0, 0, 2}.reader.readFixed32()), 0x02000001U);
    EXPECT_EQ((Input{0, 0, 0, 0, 0, 0, 0xf0, 0x3f}.reader.readDouble()), 1.0);
}

TEST(ProtoReader, TagHoldsFieldNumberAndWireType) {
    EXPECT_EQ((Input{0xa0, 0x19}.reader.readTag()), (ProtoTag{404, ProtoWireType::Varint}));
    EXPECT_EQ((Input{0x7a}.reader.readTag()), (ProtoTag{15, ProtoWireType::LengthDelimited}));
}

TEST(ProtoReader, WireTypesSixAndSevenAreErrors) {
    for (const unsigned wireType : {6U, 7U}) {
        Input input{static_cast<std::uint8_t>(0x08U | wireType)};
        input.reader.readTag();
        EXPECT_TRUE(input.reader.hasError());
    }
}

TEST(ProtoReader, LengthPastTheEndIsAnErrorWithoutAllocation) {
    Input input{0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0xff, 0x01, 'a'};
    EXPECT_TRUE(input.reader.readString().empty());
    EXPECT_TRUE(input.reader.hasError());
}

TEST(ProtoReader, SkipsAValueOfEveryWireType) {
    // varint, fixed 64, bytes, a group with a varint, fixed 32, and a last varint that is read
    Input input{0x08, 0x96, 0x01, 0x11, 0, 0,    0,    0, 0, 0, 0, 0,    0x1a, 2,
                'x',  'y',  0x23, 0x08, 7, 0x24, 0x2d, 0, 0, 0, 0, 0x30, 5};
    for (int i = 0; i < 5; ++i)
        input.reader.skip(input.reader.readTag());
    EXPECT_EQ(input.reader.readTag().fieldNumber, 6U);
    EXPECT_EQ(input.reader.readVarint(), 5U);
    EXPECT_TRUE(input.reader.isAtEnd());
    EXPECT_FALSE(input.reader.hasError());
}

TEST(ProtoReader, UnterminatedAndCrossedGroupsAreErrors) {
    Input unterminated{0x0b, 0x10, 1};
    unterminated.reader.skip(unterminated.reader.readTag());
    EXPECT_TRUE(unterminated.reader.hasError());
    Input crossed{0x0b, 0x13, 0x0c, 0x14};
    crossed.reader.skip(crossed.reader.readTag());
    EXPECT_TRUE(crossed.reader.hasError());
}

TEST(ProtoReader, GroupsNestUpToTheirLimitWithoutRecursion) {
    const auto nested = [](int depth) {
        Bytes bytes(static_cast<std::size_t>(depth), 0x0b);
        bytes.insert(bytes.end(), static_cast<std::size_t>(depth), 0x0c);
        return bytes;
    };
    Input deepest(nested(ProtoReader::MaximumGroupDepth));
    deepest.reader.skip(deepest.reader.readTag());
    EXPECT_FALSE(deepest.reader.hasError());
    Input tooDeep(nested(ProtoReader::MaximumGroupDepth + 1));
    tooDeep.reader.skip(tooDeep.reader.readTag());
    EXPECT_TRUE(tooDeep.reader.hasError());
}

TEST(ProtoReader, MarkLimitsReadingToTheSubMessage) {
    Input input{2, 0x08, 1, 0x10, 9};
    ProtoReader::Mark mark;
    ASSERT_TRUE(input.reader.placeMark(mark));
    EXPECT_EQ(input.reader.readTag().fieldNumber, 1U);
    EXPECT_EQ(input.reader.readVarint(), 1U);
    EXPECT_TRUE(input.reader.isAtEnd());
    input.reader.recallMark(mark);
    EXPECT_FALSE(input.reader.isAtEnd());
    EXPECT_EQ(input.reader.readTag().fieldNumber, 2U);
}

TEST(ProtoReader, RecalledMarkGoesOnBehindAMessageThatStoppedEarly) {
    Input input{3, 0x08, 1, 1, 0x10, 9};
    ProtoReader::Mark mark;
    ASSERT_TRUE(input.reader.placeMark(mark));
    input.reader.readTag();
    input.reader.recallMark(mark);
    EXPECT_EQ(input.reader.readTag().fieldNumber, 2U);
}

TEST(ProtoReader, ValueMayNotReachPastAMark) {
    Input input{1, 0x05, 'a', 'b', 'c', 'd', 'e'};
    ProtoReader::Mark mark;
    ASSERT_TRUE(input.reader.placeMark(mark));
    input.reader.readBytes();
    EXPECT_TRUE(input.reader.hasError());
}

TEST(ProtoReader, MarkPastTheEndFails) {
    Input input{4, 0x08, 1};
    ProtoReader::Mark mark;
    EXPECT_FALSE(input.reader.placeMark(mark));
    EXPECT_TRUE(input.reader.hasError());
}

TEST(ProtoReader, ErrorIsForGood) {
    Input input{0x80};
    input.reader.readVarint();
    EXPECT_TRUE(input.reader.isAtEnd());
    EXPECT_EQ(input.reader.readVarint(), 0U);
    EXPECT_TRUE(input.reader.readRest().empty());
    EXPECT_TRUE(input.reader.hasError());
}

} // namespace
} // namespace orvo
