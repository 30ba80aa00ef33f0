#include "platform/mapuikit/MapItem.h"

#include "platform/foundation/NSString.h"
#include "platform/geoservices/UserSession.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class FixedSession final : public UserSession {
public:
    explicit FixedSession(std::string identifier)
        : _identifier(std::move(identifier)) {}
    std::string sharedSessionID() const override { return _identifier; }

private:
    std::string _identifier;
};

class MapItemTest : public ::testing::Test {
protected:
    void share(const char* identifier) {
        session.reset();
        session.emplace(
            UserSession::instance().overrideWith(std::make_shared<FixedSession>(identifier)));
    }
    static std::string converted(const std::string& url) {
        const auto answer = MapItem::_sharedSessionURLForPunchoutURL(url);
        return answer ? answer->absoluteString() : "nil";
    }
    static std::shared_ptr<NSDictionary> info(const char* key, const char* value) {
        return NSDictionary::dictionaryWithTextKeys({{key, NSString::string(value)}});
    }

    std::optional<EnvironmentSlot<std::shared_ptr<UserSession>>::Override> session;
};

TEST_F(MapItemTest, UserInfoKeepsItsEntriesAndGainsTheSession) {
    share("S1");
    const auto converted =
        MapItem::_sharedSessionUserInfoForPunchoutUserInfo(info("bs", "payload"));
    EXPECT_EQ(converted->count(), 2U);
    EXPECT_EQ(stringValue(converted->objectForKey("bs").get()), "payload");
    EXPECT_EQ(stringValue(converted->objectForKey(MapItem::SharedSessionKey).get()), "S1");
}

TEST_F(MapItemTest, NilUserInfoBecomesTheSessionAlone) {
    share("S1");
    EXPECT_TRUE(equal(MapItem::_sharedSessionUserInfoForPunchoutUserInfo(nullptr),
                      info(MapItem::SharedSessionKey, "S1")));
}

TEST_F(MapItemTest, ConvertedTwiceIsConvertedOnce) {
    share("S1");
    const auto once = MapItem::_sharedSessionUserInfoForPunchoutUserInfo(info("a", "b"));
    EXPECT_TRUE(equal(MapItem::_sharedSessionUserInfoForPunchoutUserInfo(once), once));
    const auto url = converted("orvo://?t=r");
    EXPECT_EQ(converted(url), url);
}

TEST_F(MapItemTest, AnotherSessionTakesThePlaceOfTheEarlier) {
    share("S1");
    const auto earlier = MapItem::_sharedSessionUserInfoForPunchoutUserInfo(info("a", "b"));
    const auto url = converted("orvo://?t=r");
    share("S2");
    const auto later = MapItem::_sharedSessionUserInfoForPunchoutUserInfo(earlier);
    EXPECT_EQ(later->count(), 2U);
    EXPECT_EQ(stringValue(later->objectForKey(MapItem::SharedSessionKey).get()), "S2");
    EXPECT_EQ(converted(url), "orvo://?t=r&session=S2");
}

TEST_F(MapItemTest, WithoutASharedSessionNothingChanges) {
    share("");
    const auto given = info("a", "b");
    EXPECT_EQ(MapItem::_sharedSessionUserInfoForPunchoutUserInfo(given), given);
    EXPECT_EQ(MapItem::_sharedSessionUserInfoForPunchoutUserInfo(nullptr), nullptr);
    EXPECT_EQ(converted("orvo://?t=r"), "orvo://?t=r");
}

TEST_F(MapItemTest, URLGainsTheSessionAsItsLastParameter) {
    share("S1");
    EXPECT_EQ(converted("orvo://?t=r"), "orvo://?t=r&session=S1");
    EXPECT_EQ(converted("orvo://place"), "orvo://place?session=S1");
    EXPECT_EQ(converted("orvo://place?"), "orvo://place?session=S1");
    EXPECT_EQ(converted("orvo://place?a=1#part"), "orvo://place?a=1&session=S1#part");
    EXPECT_EQ(converted("orvo://place#part?no"), "orvo://place?session=S1#part?no");
    EXPECT_EQ(converted("orvo://?session=old&t=r&sessions=2"), "orvo://?t=r&sessions=2&session=S1");
}

TEST_F(MapItemTest, TextThatIsNoURLIsNil) {
    share("S1");
    EXPECT_EQ(converted("no url at all"), "nil");
    share("");
    EXPECT_EQ(converted("no url at all"), "nil");
}

} // namespace
} // namespace orvo
