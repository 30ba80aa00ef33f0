#include "orvo/HandOff.h"

#include "handoff/NSDataOrvoExtra.h"
#include "handoff/OrvoActivity.h"
#include "orvo/HandOffError.h"
#include "orvo/HandOffSize.h"
#include "orvo/HandOffWorld.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/PropertyList.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr const char* LineActivity = "com.zentu.Orvo.Transit.Incident";
constexpr const char* IncidentsActivity = "com.zentu.Orvo.Transit.IncidentList";

class HandOffTest : public ::testing::Test {
protected:
    std::string refusal(const std::shared_ptr<NSData>& bytes,
                        HandOffErrorCode code = HandOffErrorCode::Unreadable) {
        std::shared_ptr<NSError> error;
        const auto handOff = HandOff::ofActivity(bytes);
        EXPECT_FALSE(handOff.content(&error));
        EXPECT_FALSE(handOff.content(nullptr));
        if (!error)
            return "no error";
        EXPECT_EQ(error->domain(), HandOffErrorDomain);
        EXPECT_EQ(error->code(), static_cast<std::int64_t>(code)) << error->localizedDescription();
        return error->localizedDescription();
    }
    template <class Content>
    Content content(const HandOff& handOff) {
        std::shared_ptr<NSError> error;
        const auto found = handOff.content(&error);
        EXPECT_TRUE(found) << (error ? error->localizedDescription() : "no error");
        if (!found || !std::holds_alternative<Content>(*found))
            throw std::runtime_error("other content");
        return std::get<Content>(*found);
    }

    testing::StoppedClock clock;
    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override classes =
        CodingClassTable::current().overrideWith(testing::storableClasses());
};

std::shared_ptr<NSData> compressed(const NSData& message) {
    return NSDataOrvoExtra::bzip2CompressedData(message);
}

std::shared_ptr<NSData> lineActivity(const NSData& message) {
    return testing::travelling(LineActivity, "bs", compressed(message));
}

TEST_F(HandOffTest, ATapOnARowIsTheLineWithAllItsIncidents) {
    const auto line =
        testing::lineWith({testing::feedIncident(1, "One"), testing::feedIncident(2, "Two")});
    const auto found = content<HandOff::Line>(HandOff::ofActivity(testing::tapOnLine(line)));
    EXPECT_EQ(found.line->muid(), 7U);
    EXPECT_EQ(found.line->name(), "U1");
    const auto incidents = typed<TransitStorageIncident>(found.line->incidents());
    ASSERT_EQ(incidents.size(), 2U);
    EXPECT_EQ(incidents[1]->title(), "Two");
    EXPECT_EQ(incidents[1]->details()->timeZone, "Asia/Tokyo");
}

TEST_F(HandOffTest, ATapOnTheSummaryIsItsIncidentsInOrder) {
    const auto bytes =
        testing::tapOnIncidents({testing::feedIncident(2, "Two"), testing::feedIncident(1, "One")});
    const auto found = content<HandOff::Incidents>(HandOff::ofActivity(bytes));
    ASSERT_EQ(found.incidents.size(), 2U);
    EXPECT_EQ(found.incidents[0]->muid(), 2U);
    EXPECT_EQ(found.incidents[1]->title(), "One");
    EXPECT_TRUE(content<HandOff::Incidents>(HandOff::ofActivity(testing::tapOnIncidents({})))
                    .incidents.empty());
}

TEST_F(HandOffTest, AURLIsTheFavorites) {
    content<HandOff::Favorites>(HandOff::ofURL("orvo://?t=r"));
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(HandOff::ofURL("https://t.example").content(&error));
    EXPECT_TRUE(error);
}

TEST_F(HandOffTest, EveryCutOfAnActivityIsRefused) {
    const auto line = testing::lineWith({testing::feedIncident(1, "One")});
    for (const auto& whole :
         {testing::tapOnLine(line), testing::tapOnIncidents({testing::feedIncident(1, "One")})})
        for (std::size_t length = 0; length < whole->length(); ++length)
            EXPECT_FALSE(HandOff::ofActivity(NSData::dataWithBytes(whole->bytes().first(length)))
                             .content(nullptr))
                << length;
}

TEST_F(HandOffTest, EveryCutOfTheMessageIsRefusedOrLosesNoMoreThanFieldsAtItsEnd) {
    OrvoActivity activity;
    activity.setLineItem(TransitStorageLineItem::initWithLineItem(
        testing::lineWith({testing::feedIncident(1, "One")})));
    const auto message = activity.data();
    for (std::size_t length = 0; length < message->length(); ++length)
        refusal(lineActivity(*NSData::dataWithBytes(message->bytes().first(length))));
}

TEST_F(HandOffTest, SaysWhatIsWrong) {
    EXPECT_NE(refusal(NSData::dataWithString("junk")).find("bplist00"), std::string::npos);
    EXPECT_NE(refusal(PropertyList::write(*NSString::string("text"))).find("no activity"),
              std::string::npos);
    EXPECT_NE(refusal(testing::travelling("com.example.Other", "bs", NSString::string("x")),
                      HandOffErrorCode::Unknown)
                  .find("com.example.Other"),
              std::string::npos);
    EXPECT_NE(refusal(testing::travelling(LineActivity, "other", NSData::dataWithString("x")))
                  .find("key bs"),
              std::string::npos);
    EXPECT_NE(
        refusal(testing::travelling(LineActivity, "bs", NSString::string("x"))).find("key bs"),
        std::string::npos);
    EXPECT_NE(refusal(testing::travelling(LineActivity, "bs", NSData::dataWithString("BZh9")))
                  .find("bzip2"),
              std::string::npos);
    EXPECT_NE(refusal(lineActivity(*NSData::dataWithString("\x7a\x05"))).find("no message"),
              std::string::npos);
    EXPECT_NE(refusal(lineActivity(*NSData::dataWithString(""))).find("no line"),
              std::string::npos);
    // A line in which nothing is known is no line with good service.
    for (const auto& unknown : {std::string("\x7A\0", 2), std::string("\x7A\2\x7A\0", 4)})
        EXPECT_NE(refusal(lineActivity(*NSData::dataWithString(unknown))).find("no line"),
                  std::string::npos);
    EXPECT_NE(refusal(testing::travelling(
                          IncidentsActivity, "incidentListKey", NSData::dataWithString("x")))
                  .find("no archive"),
              std::string::npos);
}

TEST_F(HandOffTest, AnArchiveHoldsIncidentsAndNothingElse) {
    const auto archived = [](const std::shared_ptr<NSObject>& root) {
        return testing::travelling(
            IncidentsActivity,
            "incidentListKey",
            NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
                root, true, nullptr));
    };
    refusal(archived(NSString::string("text")));
    refusal(archived(NSArray::arrayWithObjects({NSString::string("text")})));
    refusal(archived(NSArray::arrayWithObjects({NSArray::array()})));
    refusal(archived(NSArray::arrayWithObjects(
        {TransitStorageLineItem::initWithLineItem(testing::lineWith({}))})));
    refusal(archived(TransitStorageIncident::initWithIncident(testing::feedIncident(1, "One"))));
}

TEST_F(HandOffTest, MoreBytesThanAnyWidgetWritesAreNotRead) {
    refusal(NSData::dataWithVector(std::vector<std::uint8_t>(HandOff::MaximumBytes + 1)),
            HandOffErrorCode::TooLarge);
}

TEST_F(HandOffTest, AStreamThatUnfoldsTooFarIsRefused) {
    const auto zeros =
        NSData::dataWithVector(std::vector<std::uint8_t>(HandOff::MaximumBytes + 1, 0));
    const auto bytes = lineActivity(*zeros);
    ASSERT_LT(bytes->length(), 10'000U);
    EXPECT_NE(refusal(bytes).find("bzip2"), std::string::npos);
}

/// A length-delimited field with a number below 16.
std::string field(unsigned number, const std::string& content) {
    std::string text(1, static_cast<char>(number << 3U | 2U));
    for (auto length = content.size(); text.size() == 1 || length > 0; length >>= 7U)
        text += static_cast<char>((length & 0x7fU) | (length > 0x7f ? 0x80U : 0U));
    return text + content;
}

TEST_F(HandOffTest, ALineOfCountlessEmptyIncidentsIsRefused) {
    std::string incidents;
    for (std::size_t i = 0; i <= HandOff::MaximumRecords; ++i)
        incidents += field(13, "");
    refusal(lineActivity(*NSData::dataWithString(field(15, incidents))),
            HandOffErrorCode::TooLarge);
}

TEST_F(HandOffTest, WhatIncidentsConcernCounts) {
    const auto stops = field(3, "") + field(3, "");
    const auto incident = field(14, stops) + field(14, "");
    const auto message = field(1, "") + field(15, field(2, "U1") + field(13, incident));
    const auto data = NSData::dataWithString(message);
    EXPECT_EQ(HandOffSize::ofActivity(data->bytes()).records, 5U);
    EXPECT_EQ(HandOffSize::ofActivity(data->bytes()).messageBytes, incident.size());
}

/// An archive of `count` incidents that share one message.
std::shared_ptr<NSData> sharingArchive(std::size_t count, const std::string& message) {
    const auto uid = [](std::uint64_t number) {
        return std::shared_ptr<NSObject>(PropertyListUID::uidWithValue(number));
    };
    const auto describe = [](const char* name) {
        return NSDictionary::dictionaryWithTextKeys(
            {{"$classname", NSString::string(name)},
             {"$classes",
              NSArray::arrayWithObjects({NSString::string(name), NSString::string("NSObject")})}});
    };
    NSArray::Elements objects{NSString::string("$null"),
                              nullptr,
                              describe("NSArray"),
                              describe("TransitStorageIncident"),
                              NSData::dataWithString(message),
                              describe("NSData")};
    NSArray::Elements references;
    for (std::size_t i = 0; i < count; ++i) {
        references.push_back(uid(objects.size()));
        objects.push_back(
            NSDictionary::dictionaryWithTextKeys({{"$class", uid(3)}, {"message", uid(4)}}));
    }
    objects[1] = NSDictionary::dictionaryWithTextKeys(
        {{"$class", uid(2)}, {"NS.objects", NSArray::arrayWithObjects(std::move(references))}});
    return PropertyList::write(*NSDictionary::dictionaryWithTextKeys(
        {{"$archiver", NSString::string("NSKeyedArchiver")},
         {"$version", NSNumber::numberWithInteger(100000)},
         {"$top", NSDictionary::dictionaryWithTextKeys({{"root", uid(1)}})},
         {"$objects", NSArray::arrayWithObjects(std::move(objects))}}));
}

TEST_F(HandOffTest, IncidentsMayShareTheirBytesWithinBounds) {
    const auto bytes =
        testing::travelling(IncidentsActivity, "incidentListKey", sharingArchive(3, field(5, "T")));
    EXPECT_EQ(content<HandOff::Incidents>(HandOff::ofActivity(bytes)).incidents.size(), 3U);
    const std::string large = field(7, std::string(HandOff::MaximumBytes / 4, 'x'));
    refusal(testing::travelling(IncidentsActivity, "incidentListKey", sharingArchive(4, large)),
            HandOffErrorCode::TooLarge);
}

} // namespace
} // namespace orvo
