#pragma once

#include "orvo/Program.h"
#include "platform/demo/DemoAlertFeed.h"
#include "platform/demo/DemoSchedule.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>

namespace orvo::testing {

/// Runs commands in a profile of the test's own, at a time that stands still, with what they print
/// as text.
class CommandTest : public ::testing::Test {
protected:
    static constexpr double Now = 1750000000; // 2025-06-15T15:06:40Z

    struct Answer {
        ExitCode code = ExitCode::Answered;
        std::string output;
        std::string error;
    };

    Answer run(const std::vector<std::string>& words, Terminal::Settings settings = {}) const {
        std::ostringstream output;
        std::ostringstream error;
        const ExitCode code = Program(Terminal(output, error, settings)).run(words);
        return {code, output.str(), error.str()};
    }

    /// Runs what must succeed, and answers what it printed.
    std::string answered(const std::vector<std::string>& words) const {
        const auto answer = run(words);
        EXPECT_EQ(answer.code, ExitCode::Answered) << answer.error;
        return answer.output;
    }

    /// Runs what must fail with that code, and answers what it said.
    std::string refused(const std::vector<std::string>& words,
                        ExitCode code = ExitCode::Failed) const {
        const auto answer = run(words);
        EXPECT_EQ(answer.code, code) << answer.output;
        return answer.error;
    }

    /// A file of that content; its path.
    std::string write(const std::string& name, std::string_view content) const {
        const auto path = profile.path() / name;
        std::filesystem::create_directories(path.parent_path());
        std::ofstream(path, std::ios::binary) << content;
        return path.string();
    }

    /// The demonstration city's schedule as a folder; its path.
    std::string writeSchedule() const {
        for (const auto& [name, text] : demoSchedule(Now, "UTC"))
            write("schedule/" + name, text);
        return (profile.path() / "schedule").string();
    }

    std::string writeAlerts(const std::vector<DemoIncident>& incidents) const {
        return write("alerts.pb", demoAlertFeed(incidents, Now)->stringView());
    }

    /// Adds the city as the feed `city` with these incidents.
    void addCity(const std::vector<DemoIncident>& incidents = {}) const {
        answered({"feeds",
                  "add",
                  "city",
                  "--static",
                  writeSchedule(),
                  "--alerts",
                  writeAlerts(incidents)});
    }

    TemporaryProfile profile;
    StoppedClock clock{Now};
    EnvironmentSlot<std::string>::Override language = Text::locale().overrideWith("en");
};

} // namespace orvo::testing
