#include "platform/foundation/Signpost.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace orvo::SignpostTests {
namespace {

TEST(Signpost, IsNotEnabledWhileNobodyLooks) {
    const auto log = Log::findOrCreate("Signposts", "com.example");
    EXPECT_FALSE(Signpost::isEnabled(*log));
    Signpost::emitEvent(*log, "Event", "message");
}

TEST(Signpost, TellsWhoLooksWithNameAndMessageOfTheLog) {
    std::vector<SignpostEvent> events;
    const auto scope =
        Signpost::sink().overrideWith([&](const SignpostEvent& event) { events.push_back(event); });
    const auto log = Log::findOrCreate("Signposts", "com.example");
    EXPECT_TRUE(Signpost::isEnabled(*log));
    Signpost::emitEvent(*log, "Event", " message ");
    ASSERT_EQ(events.size(), 1U);
    EXPECT_EQ(events[0].subsystem, "com.example");
    EXPECT_EQ(events[0].category, "Signposts");
    EXPECT_EQ(events[0].name, "Event");
    EXPECT_EQ(events[0].message, " message ");
}

TEST(Signpost, IsAProbeInTheProgramsFile) {
    std::ostringstream
        content; // in one go: programs for sanitizers are large, and slow a byte at a time
    content << std::ifstream("/proc/self/exe", std::ios::binary).rdbuf();
    const std::string program = content.str();
    const std::string probe{"orvo\0signpost_event\0",
                            20}; // provider and name, as the note has them
    EXPECT_NE(program.find(probe), std::string::npos);
}

} // namespace
} // namespace orvo::SignpostTests
