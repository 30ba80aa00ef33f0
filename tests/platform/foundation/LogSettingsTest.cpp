#include "platform/foundation/LogSettings.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Levels = std::vector<std::pair<std::string, LogLevel>>;

TEST(LogSettings, ReadsCategoriesWithTheirLevels) {
    const auto settings = LogSettings::parse("TransitWidget=debug,Result=error,*=info");
    EXPECT_EQ(settings.levels,
              (Levels{{"TransitWidget", LogLevel::Debug},
                      {"Result", LogLevel::Error},
                      {"*", LogLevel::Info}}));
    EXPECT_FALSE(settings.showsPrivate);
    EXPECT_TRUE(settings.problems.empty());
}

TEST(LogSettings, ReadsABareLevelAsThatOfEveryCategory) {
    EXPECT_EQ(LogSettings::parse("fault").levels, (Levels{{"*", LogLevel::Fault}}));
    EXPECT_EQ(LogSettings::parse("default").levels, (Levels{{"*", LogLevel::Default}}));
}

TEST(LogSettings, ShowsPrivateValuesOnRequest) {
    EXPECT_TRUE(LogSettings::parse("*=info,private").showsPrivate);
    EXPECT_TRUE(LogSettings::parse("private").levels.empty());
}

TEST(LogSettings, SaysWhichPartMeansNothingAndReadsTheOthers) {
    const auto settings = LogSettings::parse("A=loud,,B=debug,nonsense,=,");
    EXPECT_EQ(settings.levels, (Levels{{"B", LogLevel::Debug}}));
    ASSERT_EQ(settings.problems.size(), 3U);
    EXPECT_EQ(settings.problems[0],
              "ORVO_LOG: 'A=loud' is neither 'private' nor CATEGORY=LEVEL with one of the levels "
              "debug, info, default, error, fault");
    EXPECT_NE(settings.problems[1].find("'nonsense'"), std::string::npos);
    EXPECT_NE(settings.problems[2].find("'='"), std::string::npos);
}

TEST(LogSettings, SayNothingWithoutText) {
    const auto settings = LogSettings::parse("");
    EXPECT_TRUE(settings.levels.empty());
    EXPECT_TRUE(settings.problems.empty());
}

TEST(LogSettings, PreferTheCategoryToTheRestAndTheLastWord) {
    const Levels levels{{"*", LogLevel::Fault},
                        {"A", LogLevel::Error},
                        {"A", LogLevel::Debug},
                        {"*", LogLevel::Info}};
    EXPECT_EQ(LogSettings::least(levels, "A"), LogLevel::Debug);
    EXPECT_EQ(LogSettings::least(levels, "B"), LogLevel::Info);
    EXPECT_EQ(LogSettings::least({}, "B"), LogLevel::Default);
    EXPECT_EQ(LogSettings::least({{"A", LogLevel::Debug}}, "B"), LogLevel::Default);
}

} // namespace
} // namespace orvo
