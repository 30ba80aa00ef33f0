#include "platform/feeds/alerts/IncidentMerger.h"

#include "CapturedFeed.h"
#include "platform/feeds/alerts/EntityReader.h"
#include "platform/feeds/alerts/TextCleaner.h"

#include <gtest/gtest.h>

#include <deque>

namespace orvo::testing {

namespace {

Alert alert(std::string_view id,
            AlertTexts header,
            AlertTexts description = {},
            std::int32_t effect = 4) {
    Alert alert;
    alert.id = id;
    alert.effect = effect;
    alert.header = std::move(header);
    alert.description = std::move(description);
    return alert;
}

IncidentMerger::Incidents
merge(std::deque<Alert>& alerts, std::string_view agency = "en", const std::string& feed = "town") {
    IncidentMerger merger(feed, agency);
    for (Alert& each : alerts)
        merger.add(each, 0);
    return merger.take();
}

std::size_t count(std::deque<Alert> alerts, std::string_view agency = "en") {
    return merge(alerts, agency).size();
}

std::uint64_t muid(const Alert& one, std::string_view agency = "en", const char* feed = "town") {
    std::deque<Alert> alerts = {one};
    return merge(alerts, agency, feed).at(0).muid;
}

} // namespace

TEST(IncidentMerger, TheSameContentUnderOtherIdentifiersIsOneIncident) {
    std::deque<Alert> alerts = {alert("1", {{"Delay", "en"}}, {{"Fire", "en"}}),
                                alert("2", {{"Delay", "en"}}, {{"Fire", "en"}})};
    const auto incidents = merge(alerts);
    ASSERT_EQ(incidents.size(), 1U);
    EXPECT_EQ(incidents[0].members.size(), 2U);
    EXPECT_EQ(incidents[0].header.size(), 1U);
}

TEST(IncidentMerger, AnotherHeaderDescriptionOrEffectIsAnotherIncident) {
    const Alert one = alert("1", {{"Delay", "en"}}, {{"Fire", "en"}}, 4);
    EXPECT_EQ(count({one, alert("2", {{"Delays", "en"}}, {{"Fire", "en"}}, 4)}), 2U);
    EXPECT_EQ(count({one, alert("2", {{"Delay", "en"}}, {{"Water", "en"}}, 4)}), 2U);
    EXPECT_EQ(count({one, alert("2", {{"Delay", "en"}}, {{"Fire", "en"}}, 3)}), 2U);
    EXPECT_EQ(count({one, alert("2", {{"DelayFire", "en"}}, {}, 4)}), 2U);
}

TEST(IncidentMerger, MarkupAndBlanksMakeNoDifference) {
    EXPECT_EQ(count({alert("1", {{"  Retard\u00A0: tram ", "fr"}}),
                     alert("2", {{"<b>Retard</b> :&nbsp;tram", "fr"}}),
                     alert("3", {{"Retard\n:  tram", "fr"}})}),
              1U);
}

TEST(IncidentMerger, TranslationsUnderOneIdentifierAreUnited) {
    std::deque<Alert> alerts = {alert("1", {{"Delay", "en"}}, {{"Fire", "en"}}),
                                alert("2", {{"Closed", "en"}}),
                                alert("1", {{"Retard", "fr"}}, {{"Feu", "fr"}}),
                                alert("2", {{"Fermé", "fr"}})};
    const auto incidents = merge(alerts);
    ASSERT_EQ(incidents.size(), 2U);
    EXPECT_EQ(incidents[0].header.size(), 2U);
    EXPECT_EQ(incidents[0].description.size(), 2U);
    EXPECT_EQ(incidents[1].header.at(1).text, "Fermé");
}

TEST(IncidentMerger, OneIdentifierForDifferentTextsOfOneLanguageMeansDifferentIncidents) {
    EXPECT_EQ(count({alert("0", {{"Delay", "en"}}), alert("0", {{"Closed", "EN"}})}), 2U);
    EXPECT_EQ(count({alert("0", {{"Delay", ""}}), alert("0", {{"Closed", ""}})}), 2U);
    EXPECT_EQ(count({alert("0", {{"Delay", "en"}}, {}, 3), alert("0", {{"Retard", "fr"}}, {}, 4)}),
              2U);
}

TEST(IncidentMerger, ATranslationJoinsTheFirstOfItsIdentifierThatLacksItsLanguage) {
    std::deque<Alert> alerts = {alert("1", {{"One", "en"}, {"Un", "fr"}}),
                                alert("1", {{"Two", "en"}, {"Deux", "fr"}}),
                                alert("1", {{"Three", "en"}}),
                                alert("1", {{"Four", "en"}}),
                                alert("1", {{"Trois", "fr"}}),
                                alert("1", {{"Quatre", "fr"}})};
    const auto incidents = merge(alerts);
    ASSERT_EQ(incidents.size(), 4U);
    EXPECT_EQ(incidents[2].header.at(1).text, "Trois");
    EXPECT_EQ(incidents[3].header.at(1).text, "Quatre");
}

TEST(IncidentMerger, WithoutAnIdentifierNothingIsATranslation) {
    EXPECT_EQ(count({alert("", {{"Delay", "en"}}), alert("", {{"Retard", "fr"}})}), 2U);
}

TEST(IncidentMerger, IdentifiersOfDifferentSourcesHaveNothingToDoWithEachOther) {
    Alert one = alert("1", {{"Delay", "en"}});
    Alert other = alert("1", {{"Fermé", "fr"}});
    IncidentMerger merger("town", "en");
    merger.add(one, 0);
    merger.add(other, 1);
    EXPECT_EQ(merger.take().size(), 2U);
}

TEST(IncidentMerger, ContentIsComparedAcrossSources) {
    Alert one = alert("1", {{"Delay", "en"}});
    Alert other = alert("9", {{"Delay", "en"}});
    IncidentMerger merger("town", "en");
    merger.add(one, 0);
    merger.add(other, 1);
    const auto incidents = merger.take();
    ASSERT_EQ(incidents.size(), 1U);
    EXPECT_EQ(incidents[0].members.at(1).source, 1U);
}

TEST(IncidentMerger, LanguagesThatTheFirstLacksAreTakenFromTheOthers) {
    std::deque<Alert> alerts = {alert("1", {{"Delay", "en"}}),
                                alert("2", {{"Delay", "en"}, {"Retard", "fr"}})};
    const auto incidents = merge(alerts);
    ASSERT_EQ(incidents.size(), 1U);
    EXPECT_EQ(incidents[0].header.size(), 2U);
}

TEST(IncidentMerger, TheNumberIsOfTheContentInTheAgencysLanguage) {
    const Alert both = alert("1", {{"Retard", "fr"}, {"Delay", "en"}});
    EXPECT_EQ(muid(both, "en"), muid(alert("7", {{"Delay", "en"}, {"Retard", "fr"}}), "en"));
    EXPECT_EQ(muid(both, "en"), muid(alert("7", {{"Delay", "en"}}), "en"));
    EXPECT_EQ(muid(both, "fr"), muid(alert("7", {{"Retard", "fr"}}), "fr"));
    EXPECT_EQ(muid(both, "de"), muid(alert("7", {{"Retard", "fr"}}), "de"));
    EXPECT_NE(muid(both, "en"), muid(both, "fr"));
}

TEST(IncidentMerger, TheNumberIsTheSameEverywhereAndAnotherInAnotherFeed) {
    const Alert one = alert("1", {{"Delay", "en"}}, {{"Fire", "en"}});
    EXPECT_EQ(muid(one), 5368926619195846666ULL);
    EXPECT_NE(muid(one, "en", "town"), muid(one, "en", "city"));
}

TEST(IncidentMerger, RepeatsAreFoundAmongManyAndKeepTheFirstOnesPlace) {
    std::deque<std::string> ids; // views into these
    std::deque<std::string> headers;
    std::deque<Alert> alerts;
    for (int i = 0; i < 30; ++i) {
        ids.push_back(std::to_string(i));
        headers.push_back("Delay on line " + std::to_string(i % 10));
        alerts.push_back(alert(ids.back(), {{headers.back(), "en"}}));
    }
    alerts[17].header[0].text = "<i>Delay on line&nbsp;7</i>";
    const auto incidents = merge(alerts);
    ASSERT_EQ(incidents.size(), 10U);
    for (std::size_t i = 0; i < incidents.size(); ++i) {
        EXPECT_EQ(incidents[i].header.at(0).text, headers[i]);
        EXPECT_EQ(incidents[i].members.size(), 3U);
    }
}

TEST(IncidentMerger, ThreeEntitiesOfThreeLanguagesUnderOneIdentifierAreOneIncident) {
    if (capturedFeeds().empty())
        GTEST_SKIP() << "ORVO_TEST_FEEDS is not set";
    const std::vector<std::pair<const char*, std::vector<std::string>>> expected = {
        {"a",
         {"La Louviere-Sud - Pieton: Dégâts à la caténaire.",
          "La Louviere-Sud - Binche: Dégâts à la caténaire."}},
        {"b",
         {"La Louviere-Sud - Binche: Dégâts à la caténaire.",
          "La Louviere-Sud - Pieton: Dégâts à la caténaire."}},
        {"c",
         {"Nameche - Sclaigneaux: Dérangement à la signalisation.",
          "Bruxelles-Nord - Bockstael: Dérangement à la signalisation."}},
    };
    for (const auto& [name, french] : expected) {
        const std::string bytes =
            bytesOf(capturedFeeds() / "irail-nmbs-2015" / ("alerts-" + std::string(name) + ".pb"));
        const auto data = NSData::dataWithString(bytes);
        const auto message = AlertReader::read(data->bytes(), nullptr);
        ASSERT_TRUE(message);
        AlertStatistics statistics;
        EntityReader reader(statistics);
        std::deque<Alert> alerts;
        for (const std::string_view entity : message->entities)
            alerts.emplace_back(reader.read(entity).alert.value(), AlertRoom());
        EXPECT_EQ(alerts.size(), 6U);
        const auto incidents = merge(alerts, "nl");
        const auto preference = LanguagePreference::forPerson("fr-BE", "nl");
        std::vector<std::string> titles;
        for (const Incident& incident : incidents)
            titles.push_back(TextCleaner::cleanLine(preference.best(incident.header)->text));
        EXPECT_EQ(titles, french) << name;
    }
}

TEST(IncidentMerger, AnEndlessListOfLanguagesIsCut) {
    std::deque<std::string> tags;
    std::deque<Alert> alerts;
    for (int i = 0; i < 30'000; ++i) {
        tags.push_back("l" + std::to_string(i));
        alerts.push_back(alert("1", {{"Delay", tags.back()}}));
    }
    const auto incidents = merge(alerts);
    ASSERT_EQ(incidents.size(), 1U);
    EXPECT_EQ(incidents[0].members.size(), alerts.size());
    EXPECT_EQ(incidents[0].header.size(), 100U);
}

} // namespace orvo::testing
