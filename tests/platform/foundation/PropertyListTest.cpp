#include "platform/foundation/PropertyList.h"

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <fstream>
#include <limits>

namespace orvo::PropertyListTests {
namespace {

using PropertyList::ErrorCode;
using Bytes = std::vector<std::uint8_t>;

Bytes written(const std::shared_ptr<NSObject>& object) {
    std::shared_ptr<NSError> error;
    const auto data = PropertyList::write(*object, &error);
    EXPECT_TRUE(data) << descriptionOf(error);
    return data ? Bytes(data->bytes().begin(), data->bytes().end()) : Bytes();
}

/// Reads from a heap block of exactly that size, so that the sanitizer sees every byte too far.
std::shared_ptr<NSObject> readExactly(const Bytes& bytes,
                                      std::shared_ptr<NSError>* error = nullptr) {
    const auto block = std::make_unique<std::uint8_t[]>(bytes.size());
    std::copy(bytes.begin(), bytes.end(), block.get());
    return PropertyList::read({block.get(), bytes.size()}, error);
}

std::shared_ptr<NSObject> roundTrip(const std::shared_ptr<NSObject>& object) {
    return readExactly(written(object));
}

/// The code with which reading fails; 0 when it succeeds.
std::int64_t failure(const Bytes& bytes) {
    std::shared_ptr<NSError> error;
    const auto object = readExactly(bytes, &error);
    EXPECT_NE(object == nullptr, error == nullptr);
    if (!error)
        return 0;
    EXPECT_EQ(error->domain(), PropertyList::ErrorDomain);
    const auto offset = std::dynamic_pointer_cast<NSNumber>(
        error->userInfo()->objectForKey(PropertyList::ByteOffsetErrorKey));
    EXPECT_TRUE(offset);
    EXPECT_LE(offset ? offset->unsignedIntegerValue() : 0, bytes.size());
    return error->code();
}
constexpr std::int64_t code(ErrorCode value) {
    return static_cast<std::int64_t>(value);
}

/// A list by hand: objects as given, one-byte offsets and references (two-byte where `wide`).
Bytes assembled(const std::vector<Bytes>& objects, bool wide = false) {
    Bytes bytes{'b', 'p', 'l', 'i', 's', 't', '0', '0'};
    std::vector<std::size_t> offsets;
    for (const auto& object : objects) {
        offsets.push_back(bytes.size());
        bytes.insert(bytes.end(), object.begin(), object.end());
    }
    const auto table = bytes.size();
    for (const auto offset : offsets) {
        if (wide)
            bytes.push_back(static_cast<std::uint8_t>(offset >> 8U));
        bytes.push_back(static_cast<std::uint8_t>(offset));
    }
    bytes.resize(bytes.size() + 6);
    bytes.push_back(wide ? 2 : 1);
    bytes.push_back(wide ? 2 : 1);
    const auto appendWhole = [&](std::size_t value) {
        for (unsigned shift = 64; shift > 0; shift -= 8)
            bytes.push_back(static_cast<std::uint8_t>(value >> (shift - 8)));
    };
    appendWhole(objects.size());
    appendWhole(0);
    appendWhole(table);
    return bytes;
}

std::shared_ptr<NSObject> sampleList() {
    const auto text = [](const char* utf8) {
        return NSString::string(utf8);
    };
    return NSDictionary::dictionaryWithTextKeys({
        {"ascii", text("Line 7")},
        {"wide", text("Linie ü 東京 🚇")},
        {"empty", text("")},
        {"long", text("abcdefghijklmnopqrstuvwxyz")},
        {"yes", NSNumber::numberWithBool(true)},
        {"no", NSNumber::numberWithBool(false)},
        {"real", NSNumber::numberWithDouble(0.1)},
        {"whole", NSNumber::numberWithInteger(-5)},
        {"large", NSNumber::numberWithUnsignedInteger(std::numeric_limits<std::uint64_t>::max())},
        {"data", NSData::dataWithString(std::string("\0\xFF", 2) + std::string(300, 'x'))},
        {"date", NSDate::dateWithTimeIntervalSinceReferenceDate(771500000.25)},
        {"list",
         NSArray::arrayWithObjects({text("Line 7"),
                                    NSArray::array(),
                                    NSDictionary::dictionary(),
                                    PropertyListUID::uidWithValue(70000)})},
    });
}

TEST(PropertyList, EveryKindComesBackEqual) {
    const auto list = sampleList();
    EXPECT_TRUE(equal(roundTrip(list), list));
}

TEST(PropertyList, DictionariesKeepTheirOrder) {
    EXPECT_EQ(roundTrip(sampleList())->description(), sampleList()->description());
}

TEST(PropertyList, WholeNumbersOfAllWidthsComeBackWithTheirSign) {
    for (const std::int64_t value : {std::int64_t{0},
                                     std::int64_t{1},
                                     std::int64_t{-1},
                                     std::int64_t{255},
                                     std::int64_t{256},
                                     std::int64_t{65535},
                                     std::int64_t{65536},
                                     std::int64_t{4294967295},
                                     std::int64_t{4294967296},
                                     std::numeric_limits<std::int64_t>::max(),
                                     std::numeric_limits<std::int64_t>::min()}) {
        const auto number =
            std::dynamic_pointer_cast<NSNumber>(roundTrip(NSNumber::numberWithInteger(value)));
        ASSERT_TRUE(number);
        EXPECT_EQ(std::get<std::int64_t>(number->value()), value);
    }
    for (const std::uint64_t value :
         {std::uint64_t{1} << 63U, std::numeric_limits<std::uint64_t>::max()}) {
        const auto number = std::dynamic_pointer_cast<NSNumber>(
            roundTrip(NSNumber::numberWithUnsignedInteger(value)));
        ASSERT_TRUE(number);
        EXPECT_EQ(std::get<std::uint64_t>(number->value()), value);
    }
}

TEST(PropertyList, TruthValuesStayTruthValuesAndRealsStayReals) {
    const auto flag =
        std::dynamic_pointer_cast<NSNumber>(roundTrip(NSNumber::numberWithBool(true)));
    EXPECT_TRUE(std::holds_alternative<bool>(flag->value()));
    const auto list = std::dynamic_pointer_cast<NSArray>(
        roundTrip(NSArray::arrayOf<NSNumber>({NSNumber::numberWithInteger(1),
                                              NSNumber::numberWithBool(true),
                                              NSNumber::numberWithDouble(1),
                                              NSNumber::numberWithDouble(-0.0)})));
    const auto numbers = typed<NSNumber>(list);
    EXPECT_TRUE(std::holds_alternative<std::int64_t>(numbers[0]->value()));
    EXPECT_TRUE(std::holds_alternative<bool>(numbers[1]->value()));
    EXPECT_TRUE(std::holds_alternative<double>(numbers[2]->value()));
    EXPECT_TRUE(std::signbit(numbers[3]->doubleValue()));
}

TEST(PropertyList, NotANumberAndInfinityComeBack) {
    const auto real = [](double value) {
        return std::dynamic_pointer_cast<NSNumber>(roundTrip(NSNumber::numberWithDouble(value)))
            ->doubleValue();
    };
    EXPECT_TRUE(std::isnan(real(std::numeric_limits<double>::quiet_NaN())));
    EXPECT_EQ(real(-std::numeric_limits<double>::infinity()),
              -std::numeric_limits<double>::infinity());
}

TEST(PropertyList, ReadsShortReals) {
    const auto object = readExactly(assembled({{0x22, 0x3F, 0xC0, 0x00, 0x00}}));
    EXPECT_TRUE(equal(object, NSNumber::numberWithDouble(1.5)));
}

TEST(PropertyList, ReadsWholeNumbersOfSixteenBytesThatFit) {
    Bytes minusTwo(17, 0xFF);
    minusTwo[0] = 0x14;
    minusTwo[16] = 0xFE;
    EXPECT_TRUE(equal(readExactly(assembled({minusTwo})), NSNumber::numberWithInteger(-2)));
    Bytes seven(17, 0);
    seven[0] = 0x14;
    seven[16] = 7;
    EXPECT_TRUE(equal(readExactly(assembled({seven})), NSNumber::numberWithInteger(7)));
    seven[8] = 1; // 2^64 + 7
    EXPECT_EQ(failure(assembled({seven})), code(ErrorCode::Unsupported));
    minusTwo[9] = 0; // below the least signed number
    EXPECT_EQ(failure(assembled({minusTwo})), code(ErrorCode::Unsupported));
}

TEST(PropertyList, ReadsReferencesOfAllWidths) {
    const auto value = [](const Bytes& object) {
        const auto uid =
            std::dynamic_pointer_cast<PropertyListUID>(readExactly(assembled({object})));
        return uid ? uid->value() : 0;
    };
    EXPECT_EQ(value({0x80, 1}), 1U);
    EXPECT_EQ(value({0x81, 1, 2}), 0x102U);
    EXPECT_EQ(value({0x82, 1, 2, 3}), 0x10203U);
    EXPECT_EQ(value({0x87, 1, 2, 3, 4, 5, 6, 7, 8}), 0x102030405060708U);
    EXPECT_EQ(failure(assembled({{0x88, 0, 1, 2, 3, 4, 5, 6, 7, 8}})), code(ErrorCode::Corrupt));
}

TEST(PropertyList, EqualScalarsAreWrittenOnce) {
    const auto text = std::string(1000, 'a');
    const auto once = written(NSArray::arrayOf<NSString>({NSString::string(text)}));
    const auto twice =
        written(NSArray::arrayOf<NSString>({NSString::string(text), NSString::string(text)}));
    EXPECT_EQ(twice.size(), once.size() + 1); // the second reference
}

TEST(PropertyList, TheSameContentGivesTheSameBytes) {
    EXPECT_EQ(written(sampleList()), written(sampleList()));
    const auto shared = NSArray::arrayOf<NSString>({NSString::string("x")});
    const auto other = NSArray::arrayOf<NSString>({NSString::string("x")});
    EXPECT_EQ(written(NSArray::arrayOf<NSArray>({shared, shared})),
              written(NSArray::arrayOf<NSArray>({shared, other})));
}

TEST(PropertyList, ManyObjectsNeedWiderReferences) {
    for (const std::size_t count : {255U, 256U, 257U, 65535U, 65536U, 70000U}) {
        NSArray::Elements elements;
        for (std::size_t i = 0; i < count; ++i)
            elements.push_back(NSNumber::numberWithUnsignedInteger(i));
        const auto array = NSArray::arrayWithObjects(std::move(elements));
        EXPECT_TRUE(equal(roundTrip(array), array)) << count;
    }
}

TEST(PropertyList, BadTextIsMended) {
    EXPECT_TRUE(equal(roundTrip(NSString::string("a\xFF"
                                                 "b")),
                      NSString::string("a\uFFFDb")));
    EXPECT_TRUE(equal(readExactly(assembled({{0x62, 0xD8, 0x00, 0x00, 'x'}})),
                      NSString::string("\uFFFDx")));
}

TEST(PropertyList, CutAnywhereItIsNoList) {
    const auto whole = written(sampleList());
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_NE(
            failure(Bytes(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length))), 0)
            << length;
}

TEST(PropertyList, AnyByteChangedNeverReadsOutside) {
    const auto whole = written(sampleList());
    for (std::size_t i = 0; i < whole.size(); ++i)
        for (const unsigned mask : {0x01U, 0x80U, 0xFFU, 0x0FU, 0xF0U}) {
            auto bytes = whole;
            bytes[i] = static_cast<std::uint8_t>(bytes[i] ^ mask);
            failure(bytes); // answers an object or an error, each as it should be
        }
}

TEST(PropertyList, AWrongHeaderIsNoList) {
    auto bytes = assembled({{0x09}});
    ASSERT_EQ(failure(bytes), 0);
    for (std::size_t i = 0; i < 8; ++i) {
        auto wrong = bytes;
        wrong[i] ^= 1;
        EXPECT_EQ(failure(wrong), code(ErrorCode::NotBinaryPropertyList)) << i;
    }
    const std::string xml = "<?xml version=\"1.0\"?><plist version=\"1.0\"><true/></plist>";
    EXPECT_EQ(failure(Bytes(xml.begin(), xml.end())), code(ErrorCode::NotBinaryPropertyList));
}

TEST(PropertyList, AWrongTrailerIsCorrupt) {
    const auto bytes = assembled({{0xA1, 0x01}, {0x09}});
    ASSERT_EQ(failure(bytes), 0);
    const auto changed = [&](std::size_t fromTrailer, unsigned value) {
        auto wrong = bytes;
        wrong[wrong.size() - 32 + fromTrailer] = static_cast<std::uint8_t>(value);
        return failure(wrong);
    };
    for (std::size_t unused = 0; unused < 6; ++unused)
        EXPECT_EQ(changed(unused, 0xFF), 0) << unused;
    for (const unsigned width : {0U, 2U, 9U, 255U}) {
        EXPECT_EQ(changed(6, width), code(ErrorCode::Corrupt)) << width;
        EXPECT_EQ(changed(7, width), code(ErrorCode::Corrupt)) << width;
    }
    for (std::size_t field : {8U, 16U, 24U})
        for (std::size_t i = 0; i < 8; ++i)
            EXPECT_EQ(changed(field + i, 0xFF), code(ErrorCode::Corrupt)) << field + i;
    EXPECT_EQ(changed(15, 0), code(ErrorCode::Corrupt)); // no objects
    EXPECT_EQ(changed(31, 7), code(ErrorCode::Corrupt)); // the table in the header
}

TEST(PropertyList, AnOffsetThatLeadsOutsideIsCorrupt) {
    const auto bytes = assembled({{0xA1, 0x01}, {0x09}});
    for (const unsigned offset : {0U, 7U, 11U, 255U})
        for (const std::size_t entry : {34U, 33U}) { // of a part, and of the root
            auto wrong = bytes;
            wrong[wrong.size() - entry] = static_cast<std::uint8_t>(offset);
            EXPECT_EQ(failure(wrong), code(ErrorCode::Corrupt)) << offset;
        }
}

TEST(PropertyList, LengthsThatLeadOutsideAreCorrupt) {
    for (const unsigned kind : {0x40U, 0x50U, 0x60U, 0xA0U, 0xD0U}) {
        const auto marker = [&](unsigned low) {
            return static_cast<std::uint8_t>(kind | low);
        };
        EXPECT_EQ(failure(assembled({{marker(5)}})), code(ErrorCode::Corrupt)) << kind;
        EXPECT_EQ(failure(assembled({{marker(15)}})), code(ErrorCode::Corrupt)) << kind;
        EXPECT_EQ(failure(assembled({{marker(15), 0x09}})), code(ErrorCode::Corrupt)) << kind;
        EXPECT_EQ(failure(assembled({{marker(15), 0x12, 0xFF, 0xFF, 0xFF, 0xFF}})),
                  code(ErrorCode::Corrupt))
            << kind;
        EXPECT_EQ(failure(assembled(
                      {{marker(15), 0x13, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}})),
                  code(ErrorCode::Corrupt))
            << kind;
        EXPECT_EQ(failure(assembled({{marker(15), 0x13, 0x80, 0, 0, 0, 0, 0, 0, 1}})),
                  code(ErrorCode::Corrupt))
            << kind;
    }
}

TEST(PropertyList, LengthsMayBeWiderThanNeeded) {
    EXPECT_TRUE(equal(readExactly(assembled({{0x5F, 0x13, 0, 0, 0, 0, 0, 0, 0, 2, 'h', 'i'}})),
                      NSString::string("hi")));
}

TEST(PropertyList, KindsThatAreNotTakenAreSaid) {
    for (const std::uint8_t kind :
         Bytes{0x00, 0x01, 0x0C, 0x0D, 0x0E, 0x0F, 0x70, 0x90, 0xB0, 0xC0, 0xE0})
        EXPECT_EQ(failure(assembled({{kind}})), code(ErrorCode::Unsupported)) << kind;
    EXPECT_EQ(failure(assembled({{0xC1, 0x01}, {0x09}})), code(ErrorCode::Unsupported)); // a set
    EXPECT_EQ(failure(assembled({{0xD1, 0x01, 0x01}, {0x09}})), code(ErrorCode::Unsupported));
    EXPECT_EQ(failure(assembled({{0x15, 0, 0, 0, 0}})), code(ErrorCode::Corrupt));
    EXPECT_EQ(failure(assembled({{0x21, 0, 0}})), code(ErrorCode::Corrupt));
    EXPECT_EQ(failure(assembled({{0x32, 0, 0, 0, 0}})), code(ErrorCode::Corrupt));
    EXPECT_EQ(failure(assembled({{0x51, 0x80}})), code(ErrorCode::Corrupt)); // not ASCII
}

TEST(PropertyList, AnErrorSaysWhere) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(readExactly(assembled({{0xA1, 0x01}, {0xC0}}), &error));
    EXPECT_TRUE(equal(error->userInfo()->objectForKey(PropertyList::ByteOffsetErrorKey),
                      NSNumber::numberWithInteger(10)));
    EXPECT_EQ(error->localizedDescription(),
              "property list, byte 10: an object of unknown kind 0xc0");
}

TEST(PropertyList, CirclesAreRejected) {
    EXPECT_EQ(failure(assembled({{0xA1, 0x00}})), code(ErrorCode::Cyclic));
    EXPECT_EQ(failure(assembled({{0xA1, 0x01}, {0xD1, 0x02, 0x00}, {0x51, 'k'}})),
              code(ErrorCode::Cyclic));
    EXPECT_EQ(failure(assembled({{0xD1, 0x00, 0x00}})), code(ErrorCode::Cyclic));
}

TEST(PropertyList, DepthHasALimitOnBothWays) {
    const auto nested = [](std::size_t levels) {
        auto array = NSArray::array();
        for (std::size_t i = 1; i < levels; ++i)
            array = NSArray::arrayOf<NSArray>({array});
        return array;
    };
    const auto deepest = nested(PropertyList::MaximumDepth);
    EXPECT_TRUE(equal(roundTrip(deepest), deepest));
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(PropertyList::write(*nested(PropertyList::MaximumDepth + 1), &error));
    EXPECT_EQ(error->code(), code(ErrorCode::TooDeep));

    std::vector<Bytes> objects; // each in the next, read from the outermost inwards
    for (std::size_t i = 1; i < 10000; ++i)
        objects.push_back({0xA1, static_cast<std::uint8_t>(i >> 8U), static_cast<std::uint8_t>(i)});
    objects.push_back({0xA0});
    EXPECT_EQ(failure(assembled(objects, true)), code(ErrorCode::TooDeep));
}

TEST(PropertyList, DepthIsCountedThroughSharedObjects) {
    // The root's first part is the innermost, so each later part finds what it holds already read.
    std::vector<Bytes> objects{{0xAF, 0x11, 0x02, 0x58}}; // 600 parts
    for (std::size_t i = 600; i > 0; --i) {
        objects[0].push_back(static_cast<std::uint8_t>(i >> 8U));
        objects[0].push_back(static_cast<std::uint8_t>(i));
    }
    for (std::size_t i = 1; i < 600; ++i)
        objects.push_back(
            {0xA1, static_cast<std::uint8_t>((i + 1) >> 8U), static_cast<std::uint8_t>(i + 1)});
    objects.push_back({0xA0});
    EXPECT_EQ(failure(assembled(objects, true)), code(ErrorCode::TooDeep));
}

TEST(PropertyList, SharedObjectsThatUnfoldWithoutEndAreRejected) {
    std::vector<Bytes> laughs;
    for (std::uint8_t i = 1; i < 30; ++i)
        laughs.push_back({0xA2, i, i});
    laughs.push_back({0x09});
    EXPECT_EQ(failure(assembled(laughs)), code(ErrorCode::TooLarge));
    laughs.erase(laughs.begin(), laughs.begin() + 29);
    EXPECT_EQ(failure(assembled(laughs)), 0);
}

TEST(PropertyList, AnObjectAtSeveralPlacesIsOneObject) {
    const auto array =
        std::dynamic_pointer_cast<NSArray>(readExactly(assembled({{0xA2, 0x01, 0x01}, {0xA0}})));
    ASSERT_TRUE(array);
    EXPECT_EQ(array->objectAtIndex(0), array->objectAtIndex(1));
}

TEST(PropertyList, ObjectsMayNotLieOverOneAnotherToMakeMuchOfLittle) {
    // 200 texts of 255 bytes that all lie in the same 455.
    std::vector<Bytes> objects{{0xAF, 0x10, 200}};
    for (std::uint8_t i = 1; i <= 200; ++i) {
        objects[0].push_back(0);
        objects[0].push_back(i);
    }
    for (std::size_t i = 0; i < 200; ++i)
        objects.push_back({0x4F, 0x10, 0xFF});
    objects.push_back(Bytes(255, 0));
    auto bytes = assembled(objects, true);
    EXPECT_EQ(failure(bytes), code(ErrorCode::TooLarge));
}

TEST(PropertyList, ALongKeyAtManyPlacesIsRejectedOnBothWays) {
    const std::string key(1 << 14, 'k');
    NSArray::Elements dictionaries;
    for (std::size_t i = 0; i < 400; ++i)
        dictionaries.push_back(
            NSDictionary::dictionaryWithTextKeys({{key, NSNumber::numberWithBool(true)}}));
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(PropertyList::write(*NSArray::arrayWithObjects(dictionaries), &error));
    EXPECT_EQ(error->code(), code(ErrorCode::TooLarge));
    dictionaries.resize(300);
    EXPECT_TRUE(roundTrip(NSArray::arrayWithObjects(dictionaries)));

    std::vector<Bytes> objects{{0xAF, 0x11, 0x40, 0x00}}; // 16384 dictionaries
    for (std::size_t i = 0; i < 0x4000; ++i)
        objects[0].insert(objects[0].end(), {0, 1});
    objects.push_back({0xDF, 0x11, 0x01, 0x00}); // of 256 entries
    for (std::size_t i = 0; i < 512; ++i)
        objects[1].insert(objects[1].end(), {0, 2});
    objects.push_back({0x5F, 0x11, 0x40, 0x00});
    objects[2].resize(objects[2].size() + 0x4000, 'k');
    EXPECT_EQ(failure(assembled(objects, true)), code(ErrorCode::TooLarge));
}

TEST(PropertyList, WhatHasNoPlaceInTheFormatIsNotWritten) {
    const auto rejected = [](const std::shared_ptr<NSObject>& object) {
        std::shared_ptr<NSError> error;
        EXPECT_FALSE(PropertyList::write(*object, &error));
        return error ? error->localizedDescription() : "";
    };
    EXPECT_EQ(rejected(NSArray::arrayWithObjects({NSMutableSet::set()})),
              "property list: an object of class NSMutableSet has no place in it");
    EXPECT_EQ(rejected(NSDictionary::dictionaryWithEntries(
                  {{NSNumber::numberWithInteger(1), NSString::string("one")}})),
              "property list: a key of class NSNumber is no text");
}

TEST(PropertyList, TooManyObjectsAreNotWritten) {
    auto array = NSArray::array();
    for (std::size_t i = 0; i < 30; ++i)
        array = NSArray::arrayOf<NSArray>({array, array});
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(PropertyList::write(*array, &error));
    EXPECT_EQ(error->code(), code(ErrorCode::TooLarge));
}

TEST(PropertyList, SuccessLeavesNoError) {
    std::shared_ptr<NSError> error = NSError::errorWithMessage("X", 1, "earlier");
    const auto data = PropertyList::write(*NSString::string("x"), &error);
    EXPECT_FALSE(error);
    error = NSError::errorWithMessage("X", 1, "earlier");
    EXPECT_TRUE(PropertyList::read(data->bytes(), &error));
    EXPECT_FALSE(error);
}

std::string fileContent(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}
void writeFile(const std::filesystem::path& path, std::span<const std::uint8_t> bytes) {
    std::ofstream file(path, std::ios::binary);
    for (const auto byte : bytes)
        file.put(static_cast<char>(byte));
}
bool runs(const std::string& command) {
    return std::system((command + " >/dev/null 2>&1").c_str()) == 0;
}

class PropertyListWithOthers : public ::testing::Test {
protected:
    std::string path(const char* name) const { return (folder.path() / name).string(); }

    testing::TemporaryFolder folder;
};

TEST_F(PropertyListWithOthers, PlistutilReadsWhatWeWrite) {
    if (!runs("command -v plistutil"))
        GTEST_SKIP() << "plistutil is not installed";
    writeFile(path("list.plist"), written(sampleList()));
    ASSERT_TRUE(runs("plistutil -i " + path("list.plist") + " -f xml -o " + path("list.xml")));
    const auto xml = fileContent(path("list.xml"));
    for (const char* expected : {"<key>ascii</key>\n\t<string>Line 7</string>",
                                 "<string>Linie ü 東京 🚇</string>",
                                 "<true/>",
                                 "<false/>",
                                 "<integer>-5</integer>",
                                 "<integer>18446744073709551615</integer>",
                                 "<real>0.1",
                                 "<date>2025-06-13T",
                                 "<array/>",
                                 "<dict/>"})
        EXPECT_NE(xml.find(expected), std::string::npos) << expected << " in " << xml;
}

TEST_F(PropertyListWithOthers, WeReadWhatPlistutilWrites) {
    if (!runs("command -v plistutil"))
        GTEST_SKIP() << "plistutil is not installed";
    std::ofstream(path("list.xml"))
        << R"(<?xml version="1.0" encoding="UTF-8"?><plist version="1.0"><dict>)"
        << "<key>name</key><string>Øresund</string><key>n</key><integer>-300</integer>"
        << "<key>t</key><true/><key>r</key><real>2.5</real><key>d</key><data>AAEC</data>"
        << "<key>at</key><date>2001-01-01T00:01:00Z</date>"
        << "<key>l</key><array><string>a</string><string>a</string><integer>70000</integer></array>"
        << "</dict></plist>";
    ASSERT_TRUE(runs("plistutil -i " + path("list.xml") + " -f bin -o " + path("list.plist")));
    const auto content = fileContent(path("list.plist"));
    std::shared_ptr<NSError> error;
    const auto list = readExactly(Bytes(content.begin(), content.end()), &error);
    ASSERT_TRUE(list) << descriptionOf(error);
    const auto text = [](const char* utf8) {
        return NSString::string(utf8);
    };
    const auto expected = NSDictionary::dictionaryWithTextKeys({
        {"name", text("Øresund")},
        {"n", NSNumber::numberWithInteger(-300)},
        {"t", NSNumber::numberWithBool(true)},
        {"r", NSNumber::numberWithDouble(2.5)},
        {"d", NSData::dataWithString(std::string("\0\1\2", 3))},
        {"at", NSDate::dateWithTimeIntervalSinceReferenceDate(60)},
        {"l",
         NSArray::arrayWithObjects({text("a"), text("a"), NSNumber::numberWithInteger(70000)})},
    });
    EXPECT_TRUE(equal(list, expected)) << list->description();
}

TEST_F(PropertyListWithOthers, PythonReadsWhatWeWrite) {
    if (!runs("python3 -c 'import plistlib'"))
        GTEST_SKIP() << "python3 with plistlib is not installed";
    writeFile(path("list.plist"), written(sampleList()));
    std::ofstream(path("check.py")) << R"(import datetime, plistlib, sys
list = plistlib.load(open(sys.argv[1], 'rb'))
assert list['wide'] == 'Linie ü 東京 🚇'
assert list['yes'] is True and list['no'] is False and list['whole'] == -5
assert list['large'] == 2**64 - 1 and list['real'] == 0.1
assert list['data'] == b'\0\xff' + b'x' * 300
assert list['date'] == datetime.datetime(2025, 6, 13, 9, 33, 20, 250000)
assert list['list'] == ['Line 7', [], {}, plistlib.UID(70000)]
)";
    EXPECT_TRUE(runs("python3 " + path("check.py") + " " + path("list.plist")));
}

} // namespace
} // namespace orvo::PropertyListTests
