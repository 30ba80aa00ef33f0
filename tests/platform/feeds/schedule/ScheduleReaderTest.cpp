#include "platform/feeds/schedule/ScheduleReader.h"

#include "TestSchedules.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

TEST(ScheduleReader, RefusesMoreTextThanTheLimit) {
    const auto files = testing::smallSchedule();
    ImportOptions options;
    options.limits.inflatedBytes = files[0].second.size() + files[1].second.size();
    EXPECT_EQ(testing::readSchedule(files, options).error, "");
    --options.limits.inflatedBytes;
    EXPECT_THAT(testing::readSchedule(files, options).error,
                HasSubstr("city.zip: routes.txt: the schedule has more than"));
}

TEST(ScheduleReader, FilesThatAreNotReadDoNotCount) {
    auto files = testing::smallSchedule();
    files.emplace_back("shapes.txt", std::string(100'000, '\xFF'));
    ImportOptions options;
    options.limits.inflatedBytes = 10'000;
    EXPECT_EQ(testing::readSchedule(files, options).error, "");
}

TEST(ScheduleReader, RefusesMoreRowsThanTheLimitOverAllFiles) {
    ImportOptions options;
    options.limits.rows = 5; // 2 and 3
    EXPECT_EQ(testing::readSchedule(testing::smallSchedule(), options).error, "");
    options.limits.rows = 4;
    EXPECT_EQ(testing::readSchedule(testing::smallSchedule(), options).error,
              "city.zip: routes.txt: the schedule has more than 4 rows, the most that are read");
}

/// Rewrites the stated length of the archive's only file, in both places.
std::shared_ptr<NSData> withStatedSize(const NSData& zip, std::uint32_t size) {
    std::string bytes(zip.stringView());
    const auto put = [&](std::size_t at) {
        for (std::size_t part = 0; part < 4; ++part)
            bytes[at + part] = static_cast<char>(size >> (8 * part));
    };
    put(22);
    put(bytes.find("PK\x01\x02") + 24);
    return NSData::dataWithString(bytes);
}

std::string readWithStatedSize(std::uint32_t size, std::uint64_t limit) {
    std::string routes = "route_id\n";
    for (int count = 0; count < 200'000; ++count)
        routes += "R1\n";
    const auto zip = testing::zipOf({{"routes.txt", routes}});
    EXPECT_LT(zip->length(), 10'000U); // it inflates to sixty times that
    ImportOptions options;
    options.limits.inflatedBytes = limit;
    std::shared_ptr<NSError> error;
    const auto contents =
        ScheduleReader("city", options)
            .read(ScheduleSource::fromBytes(withStatedSize(*zip, size), "city.zip"), error);
    return contents ? "" : error->localizedDescription();
}

TEST(ScheduleReader, AnArchiveThatUnderstatesItsSizeIsStoppedAtTheLimit) {
    EXPECT_EQ(readWithStatedSize(10, 100'000),
              "city.zip: routes.txt: the schedule has more than 100000 bytes of text, the most "
              "that is read");
}

TEST(ScheduleReader, AnArchiveThatOverstatesItsSizeIsRefusedAtOnce) {
    EXPECT_EQ(readWithStatedSize(0xFFFFFFF0, std::uint64_t{512} << 20),
              "city.zip: routes.txt: the schedule has more than 512 MiB of text, the most that is "
              "read");
}

TEST(ScheduleReader, NamesArchiveFileAndRowOfWhatIsNoText) {
    const auto files = testing::withFile(
        testing::smallSchedule(), "stops.txt", "stop_id,stop_name\nS1,Z\xFCrich\n");
    EXPECT_EQ(testing::readSchedule(files).error,
              "city.zip: stops.txt, row 2: the text is not UTF-8");
}

TEST(ScheduleReader, ReadsUtf16ByItsMark) {
    std::string routes = "\xFF\xFE";
    for (const char character : std::string("route_id,route_short_name\r\nR1,1\r\n"))
        routes += {character, '\0'};
    const auto read = testing::readSchedule({{"routes.txt", routes}});
    ASSERT_EQ(read.error, "");
    ASSERT_EQ(read.contents.lines.size(), 1U);
    EXPECT_EQ(read.contents.lines[0].routeId, "R1");
    EXPECT_EQ(read.contents.lines[0].shortName, "1");
}

TEST(ScheduleReader, RoutesAloneAreASchedule) {
    const auto read = testing::readSchedule({{"routes.txt", "route_id\nR1\n"}});
    EXPECT_EQ(read.error, "");
    EXPECT_EQ(read.contents.info.lines, 1);
    EXPECT_EQ(read.contents.info.agencies, 0);
}

TEST(ScheduleReader, TellsItsProgressInRisingFractions) {
    auto files = testing::smallSchedule();
    std::string stops = "stop_id,stop_name\n";
    for (int number = 0; number < 30'000; ++number)
        stops += "S" + std::to_string(number) + ",Stop\n";
    files.emplace_back("stops.txt", stops);
    std::vector<ImportProgress> told;
    ImportOptions options;
    options.progress = [&](const ImportProgress& progress) {
        told.push_back(progress);
    };
    EXPECT_EQ(testing::readSchedule(files, options).error, "");
    ASSERT_GT(told.size(), 5U);
    EXPECT_LT(told.size(), 200U);
    EXPECT_EQ(told.front().file, "agency.txt");
    EXPECT_EQ(told.back().file, "stops.txt");
    EXPECT_TRUE(std::ranges::is_sorted(told, {}, &ImportProgress::fraction));
    EXPECT_LE(told.back().fraction, ScheduleReader::ShareOfImport);
}

} // namespace
} // namespace orvo
