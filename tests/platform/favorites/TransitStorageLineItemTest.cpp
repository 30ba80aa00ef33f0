#include "platform/favorites/TransitStorageLineItem.h"

#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/geoservices/FeedTransitLineItem.h"
#include "platform/geoservices/TransitAffectedEntityRecord.h"
#include "platform/geoservices/TransitSystemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

std::shared_ptr<TransitArtworkDataSource> artwork(const char* text) {
    return TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .artworkUseType = -1,
         .shieldDataSource = TransitShieldDataSource::initWithFields(
             {.shieldType = 2, .shieldText = text, .shieldColorString = "FF0000,FFFFFF"}),
         .iconDataSource = TransitIconDataSource::initWithFields({1, 2, 3, 4, 5}),
         .iconFallbackShieldDataSource =
             TransitShieldDataSource::initWithFields({.shieldText = ""}),
         .textDataSource = TransitTextDataSource::initWithFields(
             {.text = ServerFormattedString::initWithFields(
                  {.formatStrings = NSArray::arrayOf({NSString::string("a"), NSString::string("")}),
                   .alternativeString = "b"})}),
         .hasRoutingIncidentBadge = true,
         .accessibilityText = "Line"});
}

std::shared_ptr<FeedTransitIncident> incident() {
    const auto date = [](double seconds) {
        return NSDate::dateWithTimeIntervalSince1970(seconds);
    };
    return FeedTransitIncident::initWithFields_details(
        {.muid = ~std::uint64_t{0},
         .startDate = date(0.25),
         .endDate = nullptr,
         .isBlockingIncident = true,
         .title = "Closed",
         .summary = "",
         .fullDescription = "All of it\nand more",
         .messageForRoutePlanning = "p",
         .messageForRouteStepping = "s",
         .messageForNonRoutable = std::nullopt,
         .iconType = -3,
         .creationDate = date(1),
         .lastUpdated = date(2),
         .affectedEntities = NSArray::arrayOf({TransitAffectedEntityRecord::initWithFields(
             {.muid = 7,
              .hasNextStopIDs = true,
              .nextStopIDs = NSOrderedSet::orderedSetWithObjects(
                  {NSString::string("x"), NSString::string("y")})})})},
        {.feed = "city",
         .severity = IncidentSeverity::Severe,
         .effect = IncidentEffect::NoService,
         .cause = IncidentCause::Strike,
         .isPartOfLine = true,
         .isUnknown = false,
         .spokenTitle = "Closed, as spoken",
         .link = "https://example.org/1",
         .timeZone = "Europe/Paris"});
}

std::shared_ptr<FeedTransitLineItem> lineItem() {
    return FeedTransitLineItem::initWithFields_service_origin(
        {.muid = 41,
         .name = "U1",
         .identifier = MapItemIdentifier::identifierWithMuid(41),
         .system = TransitSystemRecord::initWithFields(
             {.name = "City Transit", .artwork = artwork("CT")}),
         .departureTimeDisplayStyle = 2,
         .departuresAreVehicleSpecific = true,
         .isBus = true,
         .artwork = artwork("a"),
         .modeArtwork = artwork("m"),
         .alternateArtwork = artwork("U1"),
         .hasLineColorString = true,
         .lineColorString = "FF0000",
         .showVehicleNumber = true},
        {.incidents = NSArray::arrayOf({incident()}),
         .isIncidentsTTLExpired = true,
         .hasIncidentComponent = true},
        {"city", "route-1"});
}

void expectSameIncident(const TransitIncident& a, const TransitIncident& b) {
    EXPECT_EQ(a.muid(), b.muid());
    EXPECT_TRUE(equal(a.startDate(), b.startDate()));
    EXPECT_TRUE(equal(a.endDate(), b.endDate()));
    EXPECT_EQ(a.isBlockingIncident(), b.isBlockingIncident());
    EXPECT_EQ(a.title(), b.title());
    EXPECT_EQ(a.summary(), b.summary());
    EXPECT_EQ(a.fullDescription(), b.fullDescription());
    EXPECT_EQ(a.messageForRoutePlanning(), b.messageForRoutePlanning());
    EXPECT_EQ(a.messageForRouteStepping(), b.messageForRouteStepping());
    EXPECT_EQ(a.messageForNonRoutable(), b.messageForNonRoutable());
    EXPECT_EQ(a.iconType(), b.iconType());
    EXPECT_TRUE(equal(a.creationDate(), b.creationDate()));
    EXPECT_TRUE(equal(a.lastUpdated(), b.lastUpdated()));
    const auto entitiesOfA = typed<TransitIncidentAffectedEntity>(a.affectedEntities());
    const auto entitiesOfB = typed<TransitIncidentAffectedEntity>(b.affectedEntities());
    ASSERT_EQ(entitiesOfA.size(), entitiesOfB.size());
    for (std::size_t i = 0; i < entitiesOfA.size(); ++i) {
        EXPECT_EQ(entitiesOfA[i]->muid(), entitiesOfB[i]->muid());
        EXPECT_EQ(entitiesOfA[i]->hasNextStopIDs(), entitiesOfB[i]->hasNextStopIDs());
        EXPECT_TRUE(equal(entitiesOfA[i]->nextStopIDs(), entitiesOfB[i]->nextStopIDs()));
    }
}

void expectSameLine(const TransitLineItem& a, const TransitLineItem& b) {
    EXPECT_EQ(a.muid(), b.muid());
    EXPECT_EQ(a.name(), b.name());
    EXPECT_TRUE(equal(a.identifier(), b.identifier()));
    EXPECT_EQ(a.system()->name(), b.system()->name());
    EXPECT_TRUE(equal(a.system()->artwork(), b.system()->artwork()));
    EXPECT_EQ(a.departureTimeDisplayStyle(), b.departureTimeDisplayStyle());
    EXPECT_EQ(a.departuresAreVehicleSpecific(), b.departuresAreVehicleSpecific());
    EXPECT_EQ(a.isBus(), b.isBus());
    EXPECT_TRUE(equal(a.artwork(), b.artwork()));
    EXPECT_TRUE(equal(a.modeArtwork(), b.modeArtwork()));
    EXPECT_TRUE(equal(a.alternateArtwork(), b.alternateArtwork()));
    EXPECT_EQ(a.hasLineColorString(), b.hasLineColorString());
    EXPECT_EQ(a.lineColorString(), b.lineColorString());
    EXPECT_EQ(a.showVehicleNumber(), b.showVehicleNumber());
    EXPECT_EQ(a.isIncidentsTTLExpired(), b.isIncidentsTTLExpired());
    EXPECT_EQ(a.hasIncidentComponent(), b.hasIncidentComponent());
    const auto incidentsOfA = typed<TransitIncident>(a.incidents());
    const auto incidentsOfB = typed<TransitIncident>(b.incidents());
    ASSERT_EQ(incidentsOfA.size(), incidentsOfB.size());
    for (std::size_t i = 0; i < incidentsOfA.size(); ++i)
        expectSameIncident(*incidentsOfA[i], *incidentsOfB[i]);
}

/// The classes that these archives hold.
auto storageClasses() {
    return CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem"),
                         CodingClass::of<TransitStorageIncident>("TransitStorageIncident")}));
}

TEST(TransitStorageLineItem, AnswersWhatItsLineItemAnswered) {
    const auto item = lineItem();
    const auto storage = TransitStorageLineItem::initWithLineItem(item);
    expectSameLine(*item, *storage);
    EXPECT_EQ(storage->origin(), item->origin());
    EXPECT_FALSE(TransitStorageLineItem::initWithLineItem(nullptr));
}

TEST(TransitStorageLineItem, SurvivesItsBytesAndIsMadeFromItself) {
    const auto storage = TransitStorageLineItem::initWithLineItem(lineItem());
    const auto again = protoMessageWithBytes<TransitStorageLineItem>(storage->data()->bytes());
    ASSERT_TRUE(again);
    EXPECT_TRUE(equal(storage, again));
    const auto remade = TransitStorageLineItem::initWithLineItem(again);
    expectSameLine(*storage, *remade);
    EXPECT_TRUE(equal(storage, remade));
    EXPECT_EQ(storage->hash(), remade->hash());
}

TEST(TransitStorageLineItem, NilIsKeptApartFromEmpty) {
    const auto storage =
        TransitStorageLineItem::initWithLineItem(TransitLineItemRecord::initWithFields_service(
            {.name = ""}, {.incidents = NSArray::array()}));
    EXPECT_EQ(storage->name(), "");
    ASSERT_TRUE(storage->incidents());
    EXPECT_EQ(storage->incidents()->count(), 0U);
    EXPECT_FALSE(storage->system());
    EXPECT_FALSE(storage->identifier());
    EXPECT_FALSE(storage->alternateArtwork());
    EXPECT_FALSE(storage->origin());
    const auto plainLine =
        TransitStorageLineItem::initWithLineItem(TransitLineRecord::initWithFields({.muid = 1}));
    EXPECT_FALSE(plainLine->incidents());
    EXPECT_FALSE(plainLine->name());
}

TEST(TransitStorageIncident, KeepsTheDetailsOfAFeedsIncident) {
    const auto storage = TransitStorageIncident::initWithIncident(incident());
    expectSameIncident(*incident(), *storage);
    const auto details = storage->details();
    ASSERT_TRUE(details);
    EXPECT_EQ(details->feed, "city");
    EXPECT_EQ(details->severity, IncidentSeverity::Severe);
    EXPECT_EQ(details->effect, IncidentEffect::NoService);
    EXPECT_EQ(details->cause, IncidentCause::Strike);
    EXPECT_TRUE(details->isPartOfLine);
    EXPECT_FALSE(details->isUnknown);
    EXPECT_EQ(details->spokenTitle, "Closed, as spoken");
    EXPECT_EQ(details->link, "https://example.org/1");
    EXPECT_EQ(details->timeZone, "Europe/Paris");
    EXPECT_EQ(TransitStorageIncident::initWithIncident(storage)->details()->timeZone,
              "Europe/Paris");
    EXPECT_FALSE(TransitStorageIncident::initWithIncident(TransitIncidentRecord::initWithFields({}))
                     ->details());
}

TEST(TransitStorageLineItem, ArchivesSecurely) {
    const auto classes = storageClasses();
    const auto storage = TransitStorageLineItem::initWithLineItem(lineItem());
    std::shared_ptr<NSError> error;
    const auto archive = NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        NSArray::arrayOf({storage}), true, &error);
    ASSERT_TRUE(archive) << descriptionOf(error);
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(archive, &error);
    ASSERT_TRUE(unarchiver) << descriptionOf(error);
    const auto root =
        unarchiver->decodeObjectOfClasses_forKey({"NSArray", "TransitStorageLineItem"}, "root");
    EXPECT_TRUE(equal(root, NSArray::arrayOf({storage})));
}

TEST(TransitStorageIncident, BytesThatAreNoMessageFailTheDecoding) {
    const auto classes = storageClasses();
    class Broken final : public NSSecureCoding {
    public:
        void encodeWithCoder(NSCoder& coder) const override {
            coder.encodeObject_forKey(NSData::dataWithString("\x0f"), "message");
        }
        std::vector<std::string> classesForCoder() const override {
            return {"TransitStorageIncident", "NSObject"};
        }
    };
    const auto archive = NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(
        std::make_shared<Broken>(), true, nullptr);
    ASSERT_TRUE(archive);
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(archive, nullptr);
    ASSERT_TRUE(unarchiver);
    unarchiver->setDecodingFailurePolicy(NSDecodingFailurePolicy::SetErrorAndReturn);
    EXPECT_FALSE(unarchiver->decodeObjectOfClasses_forKey({"TransitStorageIncident"}, "root"));
    EXPECT_TRUE(unarchiver->error());
}

TEST(TransitStorageArtwork, GivesBackAnEqualDescriptor) {
    const auto original = artwork("U1");
    EXPECT_TRUE(equal(TransitStorageArtwork::initWithArtwork(original)->artwork(), original));
    const auto empty = TransitArtworkDataSource::initWithFields({});
    EXPECT_TRUE(equal(TransitStorageArtwork::initWithArtwork(empty)->artwork(), empty));
    EXPECT_FALSE(TransitStorageArtwork::initWithArtwork(nullptr));
    EXPECT_FALSE(artworkOf(nullptr));
}

TEST(TransitStorageArtwork, BytesThatAreNoArtworkAreNil) {
    auto storage = std::make_shared<TransitStorageArtwork>();
    storage->setBytes({0x1a, 0x05, 0x08});
    EXPECT_FALSE(storage->artwork());
}

} // namespace
} // namespace orvo
