#include "print/WidgetProgram.h"

#include "platform/demo/DemoIncidents.h"
#include "platform/demo/DemoProfile.h"
#include "platform/extension/WidgetHost.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/RunLoop.h"
#include "print/SceneWorld.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>

namespace orvo {
namespace {

using Exit = ExitCode;

class WidgetProgramTest : public ::testing::Test, protected testing::SceneWorld {
protected:
    Exit run(const std::vector<std::string>& words) {
        output.str("");
        error.str("");
        return WidgetProgram(extension(),
                             Terminal(output, error, {.program = WidgetOptions::ProgramName}))
            .run(words);
    }

    RunLoop& loop = RunLoop::main();
    std::ostringstream output;
    std::ostringstream error;
};

TEST_F(WidgetProgramTest, PrintsTheRowsOfTheFavorites) {
    lookup->answerWith(
        {NSArray::arrayOf(std::vector{testing::line(1, "U1", {testing::incident(11, "Delays")})}),
         nullptr});
    EXPECT_EQ(run({}), Exit::Answered);
    EXPECT_EQ(output.str().rfind("compact:\n0  [U1]  Delays\n", 0), 0U) << output.str();
    EXPECT_EQ(error.str(), "");
}

TEST_F(WidgetProgramTest, AFailedLookupIsARowAndAnswered) {
    lookup->answerWith({nullptr, NSError::errorWithMessage("Test", 1, "no")});
    EXPECT_EQ(run({"--print", "waybar"}), Exit::Answered);
    EXPECT_NE(output.str().find("unavailable"), std::string::npos);
}

TEST_F(WidgetProgramTest, FavoritesThatCannotBeReadAreToldBesideTheRow) {
    const auto file = FavoritesStore::standardPath();
    std::filesystem::remove(file);
    std::filesystem::create_symlink(file.filename(), file); // a loop, which root cannot read either
    answerWith({}); // of an earlier test's favourites, which the container still knows
    EXPECT_EQ(run({}), Exit::Failed);
    EXPECT_EQ(error.str(),
              "orvo-transit-widget: " + file.string() +
                  ": the favorites cannot be opened: Too many levels of symbolic links\n");
    EXPECT_NE(output.str(), "");
    std::filesystem::remove(file);
    EXPECT_EQ(run({}), Exit::Answered);
    EXPECT_EQ(error.str(), "");
}

TEST_F(WidgetProgramTest, PrintingKeepsWritesInMemoryAndPutsTheEnvironmentBack) {
    bool keptInMemory = false;
    double now = 0;
    std::string language;
    class Watching final : public LookupService {
    public:
        explicit Watching(std::function<void()> seen)
            : _seen(std::move(seen)) {}
        std::shared_ptr<LineItemTicket>
        ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                     const std::shared_ptr<NSObject>& traits) override {
            _seen();
            auto fake = std::make_shared<testing::FakeLookup>();
            fake->answerWith({NSArray::array(), nullptr});
            return fake->ticketForTransitLines_traits(identifiers, traits);
        }

    private:
        std::function<void()> _seen;
    };
    const auto watching = LookupService::shared().overrideWith(std::make_shared<Watching>([&] {
        keptInMemory = Environment::keepsWritesInMemory().get();
        now = NSDate::date()->timeIntervalSince1970();
        language = Text::locale().get();
    }));
    EXPECT_EQ(run({"--at", "1970-01-02T00:00:00Z", "--language", "pt_BR"}), Exit::Answered);
    EXPECT_TRUE(keptInMemory);
    EXPECT_EQ(now, 86400);
    EXPECT_EQ(language, "pt-BR");
    EXPECT_FALSE(Environment::keepsWritesInMemory().get());
    EXPECT_EQ(Text::locale().get(), "en");
    EXPECT_NE(NSDate::date()->timeIntervalSince1970(), 86400);
}

TEST_F(WidgetProgramTest, HelpVersionAndWrongUsageAskNobody) {
    EXPECT_EQ(run({"--help"}), Exit::Answered);
    EXPECT_EQ(run({"--version"}), Exit::Answered);
    EXPECT_EQ(output.str().rfind("orvo-transit-widget ", 0), 0U);
    EXPECT_EQ(run({"--print", "xml"}), Exit::WrongUsage);
    EXPECT_EQ(error.str(),
              "orvo-transit-widget: --print cannot be xml\nChoose one of text, json, waybar.\n");
    EXPECT_EQ(output.str(), "");
    EXPECT_TRUE(lookup->asked().empty());
}

/// The size in pixels that a PNG file says it has.
std::pair<std::uint32_t, std::uint32_t> pixelsOf(const std::filesystem::path& file) {
    std::ifstream stream(file, std::ios::binary);
    std::vector<unsigned char> head(24);
    stream.read(reinterpret_cast<char*>(head.data()), 24);
    const auto number = [&](std::size_t at) {
        return static_cast<std::uint32_t>(head[at] << 24 | head[at + 1] << 16 | head[at + 2] << 8 |
                                          head[at + 3]);
    };
    return {number(16), number(20)};
}

TEST_F(WidgetProgramTest, DrawsAllRowsOfTheModeInPixelsOfTheScale) {
    const auto file = profile.path() / "card.png";
    const auto draw = [&](std::vector<std::string> words) {
        answerWith(threeLines());
        words.insert(words.begin(), {"--snapshot", file.string()});
        EXPECT_EQ(run(words), Exit::Answered) << error.str();
        return pixelsOf(file);
    };
    EXPECT_EQ(draw({"--mode", "compact"}), std::pair(359U, 36U + 110U));
    EXPECT_EQ(draw({}), std::pair(359U, 36U + 3 * 110U)) << "all that there is";
    EXPECT_EQ(draw({"--mode", "expanded", "--scale", "3"}), std::pair(1077U, 1098U));
    EXPECT_EQ(draw({"--text-size", "AX5", "--width", "400"}), std::pair(400U, 36U + 3 * 343U));
    EXPECT_EQ(draw({"--max-rows", "2"}), std::pair(359U, 36U + 2 * 110U));
    EXPECT_FALSE(std::filesystem::exists(file.string() + ".new"));
}

TEST_F(WidgetProgramTest, BesideWhatIsPrintedItDrawsBothModes) {
    answerWith(threeLines());
    const auto folder = profile.path() / "some" / "pictures";
    ASSERT_EQ(run({"--pictures", folder.string()}), Exit::Answered);
    EXPECT_EQ(output.str().rfind("compact:\n", 0), 0U);
    EXPECT_EQ(pixelsOf(folder / "widget-compact.png"), std::pair(359U, 36U + 110U));
    EXPECT_EQ(pixelsOf(folder / "widget-expanded.png"), std::pair(359U, 36U + 3 * 110U));
    EXPECT_EQ(error.str(),
              "Picture: " + (folder / "widget-compact.png").string() +
                  "\nPicture: " + (folder / "widget-expanded.png").string() + "\n");
    answerWith({});
    const auto other = profile.path() / "other";
    ASSERT_EQ(run({"--pictures", other.string()}), Exit::Answered);
    EXPECT_FALSE(std::filesystem::exists(other / "widget-expanded.png")) << "nothing more to show";
    answerWith({});
    EXPECT_EQ(run({"--pictures", (other / "widget-compact.png").string()}), Exit::Failed);
}

TEST_F(WidgetProgramTest, APictureThatCannotBeWrittenIsNamed) {
    answerWith(threeLines());
    const auto file = (profile.path() / "no folder" / "card.png").string();
    EXPECT_EQ(run({"--snapshot", file}), Exit::Failed);
    EXPECT_EQ(error.str(), "orvo-transit-widget: " + file + ": No such file or directory\n");
    answerWith(threeLines());
    EXPECT_EQ(run({"--snapshot", profile.path().string()}), Exit::Failed);
    EXPECT_NE(error.str().find(profile.path().string() + ": "), std::string::npos);
}

TEST_F(WidgetProgramTest, AnExpandedPictureNeedsMoreToShow) {
    answerWith({});
    EXPECT_EQ(run({"--snapshot", "unused.png", "--mode", "expanded"}), Exit::Failed);
    EXPECT_EQ(error.str(), "orvo-transit-widget: there is nothing more to show in expanded mode\n");
}

TEST_F(WidgetProgramTest, DumpsTheViewsOfEveryRow) {
    answerWith(threeLines());
    ASSERT_EQ(run({"--dump", "views"}), Exit::Answered);
    EXPECT_EQ(output.str().rfind("WidgetCard1 0 0 359 366\n", 0), 0U) << output.str();
    EXPECT_NE(output.str().find("OWTransitItemFixedHeightCell3 16 256 327 110"), std::string::npos)
        << output.str();
    EXPECT_NE(output.str().find("\"Delays\""), std::string::npos);
}

TEST_F(WidgetProgramTest, ARightToLeftLanguageMirrorsTheCard) {
    answerWith(threeLines());
    ASSERT_EQ(run({"--dump", "views", "--language", "ar"}), Exit::Answered);
    EXPECT_NE(output.str().find("UIImageView1 327 8 20 20"), std::string::npos) << output.str();
}

TEST_F(WidgetProgramTest, DumpsTheConstraintsOfTheCardAndOfEachRow) {
    answerWith(threeLines());
    ASSERT_EQ(run({"--dump", "constraints"}), Exit::Answered);
    for (const char* row : {"row 0: ", "row 1: ", "row 2: "})
        EXPECT_NE(output.str().find(row + std::string("OWTransitItemFixedHeightCell\n")),
                  std::string::npos);
}

TEST_F(WidgetProgramTest, DumpsWhatIsKeptBetweenStarts) {
    answerWith(threeLines());
    ASSERT_EQ(run({"--dump", "archive"}), Exit::Answered);
    EXPECT_NE(output.str().find("$archiver = \"NSKeyedArchiver\""), std::string::npos);
    EXPECT_NE(output.str().find("expanded = 1"), std::string::npos);
    EXPECT_NE(output.str().find("\"TransitStorageLineItem\""), std::string::npos);
}

/// Shows the widget in a window that nobody sees, of which it notes what the program gave it.
struct NotedWindow {
    WidgetWindowing windowing() {
        return {.makeApplication = [this] { ++applications; },
                .run =
                    [this](const Extension& extension,
                           const WidgetHostSettings& given,
                           const WidgetWindowing::Began& began) {
                        settings = given;
                        keptInMemory = Environment::keepsWritesInMemory().get();
                        checksSchedules = ScheduleUpdater::checksDaily().get();
                        now = NSDate::date()->timeIntervalSince1970();
                        traits = UITraitCollection::system().get();
                        const auto host = WidgetHost::hostWithExtension_settings(extension, given);
                        began(host);
                        while_(host);
                        return 0;
                    }};
    }

    int applications = 0;
    WidgetHostSettings settings;
    bool keptInMemory = false;
    bool checksSchedules = false;
    double now = 0;
    UITraitCollection traits;
    std::function<void(const std::shared_ptr<WidgetHost>&)> while_ = [](const auto&) {
    };
};

class WindowTest : public WidgetProgramTest {
protected:
    Exit runInWindow(const std::vector<std::string>& words) {
        return WidgetProgram(extension(),
                             Terminal(output, error, {.program = WidgetOptions::ProgramName}),
                             window.windowing())
            .run(words);
    }

    NotedWindow window;
};

TEST_F(WindowTest, IsOpenedWithWhatTheCommandLineSays) {
    EXPECT_EQ(runInWindow({"--width", "300", "--mode", "expanded", "--max-rows", "2"}),
              Exit::Answered);
    EXPECT_EQ(window.applications, 1);
    EXPECT_EQ(window.settings.width, 300);
    EXPECT_EQ(window.settings.mode, NCWidgetDisplayMode::Expanded);
    EXPECT_EQ(window.settings.maxRows, 2U);
    EXPECT_TRUE(window.settings.followsLanguage);
    EXPECT_EQ(output.str() + error.str(), "");
}

TEST_F(WindowTest, LanguageThatWasNamedStays) {
    EXPECT_EQ(runInWindow({"--language", "de"}), Exit::Answered);
    EXPECT_FALSE(window.settings.followsLanguage);
}

TEST_F(WindowTest, LivesOnSoItMovesKeepsAndLooksForNewerSchedules) {
    EXPECT_EQ(runInWindow({}), Exit::Answered);
    EXPECT_EQ(window.settings.mode, std::nullopt) << "the one chosen last";
    EXPECT_FALSE(window.traits.reducesMotion);
    EXPECT_FALSE(window.keptInMemory);
    EXPECT_TRUE(window.checksSchedules);
}

TEST_F(WindowTest, AtAnotherTimeItKeepsNothingAndTheClockGoesOn) {
    window.while_ = [](const auto&) {
        const auto begin = NSDate::date()->timeIntervalSince1970();
        const auto later = [&] {
            return NSDate::date()->timeIntervalSince1970() > begin;
        };
        EXPECT_TRUE(RunLoop::main().runUntil(later, 60));
    };
    EXPECT_EQ(runInWindow({"--at", "1970-01-02T00:00:00Z", "--language", "ar"}), Exit::Answered);
    EXPECT_TRUE(window.keptInMemory);
    EXPECT_NEAR(window.now, 86400, 60);
    EXPECT_EQ(window.traits.layoutDirection, UIUserInterfaceLayoutDirection::RightToLeft);
}

TEST_F(WindowTest, WithATaskThereIsNone) {
    answerWith({});
    EXPECT_EQ(runInWindow({"--print", "text"}), Exit::Answered);
    EXPECT_EQ(window.applications, 0);
    EXPECT_EQ(output.str().rfind("compact:\n", 0), 0U);
}

/// The demonstration's folders follow the base directories, which belong to the process.
class DemonstrationTest : public WidgetProgramTest {
protected:
    void SetUp() override {
        for (const char* name : {"XDG_DATA_HOME", "XDG_CACHE_HOME", "XDG_STATE_HOME"})
            setenv(name, (profile.path() / name).c_str(), 1);
    }
    void TearDown() override {
        for (const char* name : {"XDG_DATA_HOME", "XDG_CACHE_HOME", "XDG_STATE_HOME"})
            unsetenv(name);
    }
};

TEST_F(DemonstrationTest, AnotherTimeLeavesNoTrace) {
    lookup->answerWith({NSArray::array(), nullptr});
    EXPECT_EQ(run({"--demo", "--at", "2025-06-15T12:00:00Z"}), Exit::Answered);
    EXPECT_FALSE(lookup->asked().empty());
    EXPECT_FALSE(std::filesystem::exists(profile.path() / "XDG_DATA_HOME"));
}

/// Answers at once, and notes whether the city was current when it was asked.
class CurrentCityLookup final : public LookupService {
public:
    std::shared_ptr<LineItemTicket>
    ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                 const std::shared_ptr<NSObject>& traits) override {
        wasCurrent.push_back(DemoProfile::isCurrent());
        const auto fake = std::make_shared<testing::FakeLookup>();
        fake->answerWith({NSArray::array(), nullptr});
        return fake->ticketForTransitLines_traits(identifiers, traits);
    }

    std::vector<bool> wasCurrent;
};

TEST_F(DemonstrationTest, FollowedItGoesOnWhenItsHourIsOver) {
    const auto city = std::make_shared<CurrentCityLookup>();
    const auto asked = LookupService::shared().overrideWith(city);
    // An hour goes by when the first answer is printed; the second question is the last.
    bool hourIsOver = false;
    const std::function<void()> look = [&] {
        if (city->wasCurrent.size() > 1)
            return loop.stop();
        if (!hourIsOver && !output.str().empty()) {
            hourIsOver = true;
            world.clock->advance(DemoIncidents::LifetimeSeconds);
            loop.checkTimers();
        }
        DispatchQueue::mainQueue()->async(look);
    };
    DispatchQueue::mainQueue()->async(look);
    EXPECT_EQ(run({"--demo", "--follow"}), Exit::Answered);
    EXPECT_EQ(city->wasCurrent, (std::vector<bool>{true, true}));
    EXPECT_EQ(error.str(), "");
}

TEST_F(DemonstrationTest, InAWindowItGoesOnWhenItsHourIsOver) {
    const auto city = std::make_shared<CurrentCityLookup>();
    const auto asked = LookupService::shared().overrideWith(city);
    NotedWindow window;
    window.while_ = [&](const std::shared_ptr<WidgetHost>& host) {
        host->setShown(true);
        EXPECT_TRUE(loop.runUntil([&] { return !city->wasCurrent.empty(); }, 60));
        loop.runOnce();
        EXPECT_LE(loop.scheduledTimers(), 3U) << "no timer that goes off while nothing happens";
        world.clock->advance(DemoIncidents::LifetimeSeconds + 1);
        loop.checkTimers();
        EXPECT_TRUE(DemoProfile::isCurrent());
        // The half-hour's refresh may be first, of the city that was.
        const auto before = city->wasCurrent.size();
        EXPECT_TRUE(loop.runUntil(
            [&] { return city->wasCurrent.size() > before && city->wasCurrent.back(); }, 60));
        host->setShown(false);
    };
    EXPECT_EQ(
        WidgetProgram(extension(), Terminal(output, error, {}), window.windowing()).run({"--demo"}),
        Exit::Answered);
    EXPECT_GE(city->wasCurrent.size(), 2U);
    EXPECT_EQ(error.str(), "");
}

TEST_F(WidgetProgramTest, ARowThatIsNotThereFails) {
    answerWith({});
    EXPECT_EQ(run({"--open", "7"}), Exit::Failed);
    EXPECT_EQ(error.str(),
              "orvo-transit-widget: there is no row 7 in compact mode: the last is 0\n");
}

} // namespace
} // namespace orvo
