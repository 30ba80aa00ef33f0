#include "platform/foundation/Environment.h"

#include "platform/foundation/NSDate.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <optional>
#include <string>

namespace orvo {
namespace {

/// Sets a variable, or takes it away, for the scope of a test.
class Variable {
public:
    Variable(const char* name, const char* value)
        : _name(name) {
        if (const char* earlier = std::getenv(name))
            _earlier = earlier;
        apply(value);
    }
    Variable(const Variable&) = delete;
    Variable& operator=(const Variable&) = delete;
    ~Variable() { apply(_earlier ? _earlier->c_str() : nullptr); }

private:
    void apply(const char* value) const {
        if (value)
            setenv(_name, value, 1);
        else
            unsetenv(_name);
    }
    const char* _name;
    std::optional<std::string> _earlier;
};

TEST(ProfileFolders, LieBelowTheHomeFolderUnlessToldOtherwise) {
    const Variable home("HOME", "/home/somebody");
    const Variable data("XDG_DATA_HOME", nullptr);
    const Variable cache("XDG_CACHE_HOME", "");
    const Variable state("XDG_STATE_HOME", "relative/path");
    const auto folders = ProfileFolders::standard();
    EXPECT_EQ(folders.data, "/home/somebody/.local/share/group.com.zentu.Orvo");
    EXPECT_EQ(folders.cache, "/home/somebody/.cache/group.com.zentu.Orvo");
    EXPECT_EQ(folders.state, "/home/somebody/.local/state/group.com.zentu.Orvo");
}

TEST(ProfileFolders, FollowTheBaseDirectories) {
    const Variable data("XDG_DATA_HOME", "/a");
    const Variable cache("XDG_CACHE_HOME", "/b");
    const Variable state("XDG_STATE_HOME", "/c");
    const auto folders = ProfileFolders::demonstration();
    EXPECT_EQ(folders.data, "/a/group.com.zentu.Orvo.demo");
    EXPECT_EQ(folders.cache, "/b/group.com.zentu.Orvo.demo");
    EXPECT_EQ(folders.state, "/c/group.com.zentu.Orvo.demo");
}

TEST(Environment, DrawsRandomNumbersThatDiffer) {
    const auto random = Environment::random().get();
    const auto first = random();
    int same = 0;
    for (int i = 0; i < 16; ++i)
        same += random() == first;
    EXPECT_LT(same, 4);
}

TEST(Environment, WritesToTheDiskUnlessToldOtherwise) {
    EXPECT_FALSE(Environment::keepsWritesInMemory().get());
}

// The default clock is made once, so each of these asks in a process of its own.
void showsYear(const char* now, double since1970, double until1970) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(
        {
            setenv("ORVO_NOW", now, 1);
            const double shown = NSDate::date()->timeIntervalSince1970();
            std::exit(shown >= since1970 && shown < until1970 ? 0 : 1);
        },
        ::testing::ExitedWithCode(0),
        "");
}

TEST(Environment, StartsItsClockAtTheTimeThatAVariableSays) {
    showsYear("2024-07-24T01:28:40Z", 1721784520, 1721784520 + 60);
}

TEST(Environment, ShowsTheMachinesTimeWhereTheVariableSaysNone) {
    showsYear("yesterday", 1735689600, 1e11);
}

} // namespace
} // namespace orvo
