#include "print/WidgetOptions.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

WidgetOptions parsed(const std::vector<std::string>& words) {
    const auto result = WidgetOptions::parse(words);
    if (const auto* error = std::get_if<UsageError>(&result))
        ADD_FAILURE() << error->message;
    return std::holds_alternative<WidgetOptions>(result) ? std::get<WidgetOptions>(result)
                                                         : WidgetOptions{};
}

std::string refused(const std::vector<std::string>& words,
                    WidgetOptions::Display display = WidgetOptions::Display::None) {
    const auto result = WidgetOptions::parse(words, display);
    const auto* error = std::get_if<UsageError>(&result);
    return error ? error->message : "was accepted";
}

TEST(WidgetOptions, WithoutWordsPrintsTextAndAsManyRowsAsFit) {
    const auto options = parsed({});
    EXPECT_EQ(options.form, WidgetOptions::Form::Text);
    EXPECT_EQ(options.maxRows, std::nullopt);
    EXPECT_FALSE(options.follows);
    EXPECT_FALSE(options.open);
}

TEST(WidgetOptions, OnADisplayAWindowIsShownUnlessSomethingElseIsAskedFor) {
    const auto showsWindow = [](const std::vector<std::string>& words) {
        return std::get<WidgetOptions>(WidgetOptions::parse(words, WidgetOptions::Display::Present))
            .showsWindow;
    };
    EXPECT_FALSE(parsed({}).showsWindow);
    EXPECT_FALSE(parsed({"--demo"}).showsWindow);
    EXPECT_TRUE(showsWindow({}));
    EXPECT_TRUE(showsWindow({"--demo", "--at", "2025-06-15T12:00:00Z", "--language", "de"}));
    EXPECT_TRUE(showsWindow({"--mode", "expanded", "--width", "300", "--max-rows", "2"}));
    EXPECT_TRUE(showsWindow({"--pictures", "folder", "--scale", "2"}));
    for (const auto& words : std::vector<std::vector<std::string>>{{"--print", "text"},
                                                                   {"--follow"},
                                                                   {"--open", "0"},
                                                                   {"--snapshot", "a"},
                                                                   {"--dump", "views"}})
        EXPECT_FALSE(showsWindow(words)) << words.front();
}

TEST(WidgetOptions, AWindowLooksAsTheDesktopDoes) {
    EXPECT_EQ(refused({"--dark"}, WidgetOptions::Display::Present),
              "--dark belongs to --snapshot, --pictures or --dump");
    EXPECT_EQ(refused({"--width", "400"}),
              "--width belongs to --snapshot, --pictures, --dump or a window");
}

TEST(WidgetOptions, ReadsEveryOption) {
    EXPECT_EQ(parsed({"--print", "json"}).form, WidgetOptions::Form::Json);
    EXPECT_EQ(parsed({"--print", "waybar"}).form, WidgetOptions::Form::Waybar);
    EXPECT_TRUE(parsed({"--print=json", "--payloads"}).withPayloads);
    EXPECT_TRUE(parsed({"--follow"}).follows);
    EXPECT_EQ(parsed({"--max-rows", "0"}).maxRows, 0U);
    EXPECT_EQ(parsed({"--open", "3"}).open, 3U);
    EXPECT_FALSE(parsed({"--open", "3"}).mode);
    EXPECT_EQ(parsed({"--open", "0", "--mode", "compact"}).mode, NCWidgetDisplayMode::Compact);
    EXPECT_EQ(parsed({"--open", "0", "--mode", "expanded"}).mode, NCWidgetDisplayMode::Expanded);
    EXPECT_EQ(parsed({"--at", "1970-01-02T00:00:00Z"}).at, 86400);
    EXPECT_EQ(parsed({"--language", "pt-BR"}).language, "pt-BR");
    EXPECT_TRUE(parsed({"--demo"}).usesDemonstration);
    EXPECT_TRUE(parsed({"--version"}).wantsVersion);
    EXPECT_TRUE(parsed({"-h"}).wantsHelp);
}

TEST(WidgetOptions, ReadsHowAPictureLooks) {
    const auto plain = parsed({"--snapshot", "card.png"});
    EXPECT_EQ(plain.snapshot, "card.png");
    EXPECT_EQ(plain.width, 359);
    EXPECT_EQ(plain.traits, UITraitCollection{.reducesMotion = true});
    const auto options = parsed({"--snapshot=card.png",
                                 "--width=400",
                                 "--scale=3",
                                 "--text-size=AX5",
                                 "--dark",
                                 "--contrast",
                                 "--mode=compact"});
    EXPECT_EQ(options.width, 400);
    EXPECT_EQ(options.traits,
              (UITraitCollection{.userInterfaceStyle = UIUserInterfaceStyle::Dark,
                                 .accessibilityContrast = UIAccessibilityContrast::High,
                                 .preferredContentSizeCategory = UIContentSizeCategory::AX5,
                                 .displayScale = 3,
                                 .reducesMotion = true}));
    EXPECT_EQ(options.mode, NCWidgetDisplayMode::Compact);
    EXPECT_EQ(parsed({"--pictures", "folder"}).pictures, "folder");
}

TEST(WidgetOptions, ReadsWhatToDump) {
    using Dump = WidgetOptions::Dump;
    EXPECT_EQ(parsed({"--dump", "views"}).dump, Dump::Views);
    EXPECT_EQ(parsed({"--dump", "constraints"}).dump, Dump::Constraints);
    EXPECT_EQ(parsed({"--dump", "archive", "--max-rows", "2"}).dump, Dump::Archive);
}

TEST(WidgetOptions, RefusesPicturesThatCannotBe) {
    EXPECT_EQ(refused({"--snapshot", "a", "--scale", "4"}), "--scale cannot be 4");
    EXPECT_EQ(refused({"--snapshot", "a", "--text-size", "XX"}), "--text-size cannot be XX");
    EXPECT_EQ(refused({"--snapshot", "a", "--width", "159"}), "--width: \"159\" is no width");
    EXPECT_EQ(refused({"--snapshot", "a", "--width", "2001"}), "--width: \"2001\" is no width");
    EXPECT_EQ(refused({"--dark"}), "--dark belongs to --snapshot, --pictures or --dump");
    EXPECT_EQ(refused({"--print", "text", "--scale", "2"}),
              "--scale belongs to --snapshot, --pictures or --dump");
    EXPECT_EQ(refused({"--pictures", "a", "--follow"}), "--pictures does not go with --follow");
    EXPECT_EQ(refused({"--pictures", "a", "--snapshot", "b"}),
              "--pictures does not go with --snapshot");
    EXPECT_EQ(refused({"--snapshot", "a", "--dump", "views"}),
              "--snapshot does not go with --dump");
    EXPECT_EQ(refused({"--snapshot", "a", "--follow"}), "--snapshot does not go with --follow");
}

TEST(WidgetOptions, RefusesWhatCannotBeRead) {
    EXPECT_EQ(refused({"--print", "xml"}), "--print cannot be xml");
    EXPECT_EQ(refused({"--print"}), "--print needs a value");
    EXPECT_EQ(refused({"--open", "first"}), "--open: \"first\" is no number of rows");
    EXPECT_EQ(refused({"--open=-1"}), "--open: \"-1\" is no number of rows");
    EXPECT_EQ(refused({"--max-rows", "18446744073709551616"}),
              "--max-rows: \"18446744073709551616\" is no number of rows");
    EXPECT_EQ(refused({"--at", "noon"}), "--at: \"noon\" is no time");
    EXPECT_EQ(refused({"--language", "?"}), "--language: \"?\" is no language");
    EXPECT_EQ(refused({"rows"}), "\"rows\" is one word too many");
}

TEST(WidgetOptions, RefusesWhatMakesNoSenseTogether) {
    EXPECT_EQ(refused({"--open", "0", "--print", "text"}), "--open does not go with --print");
    EXPECT_EQ(refused({"--open", "0", "--follow"}), "--open does not go with --follow");
    EXPECT_EQ(refused({"--mode", "compact"}),
              "--mode belongs to --open, --snapshot, --dump or a window");
    EXPECT_EQ(refused({"--payloads"}), "--payloads belongs to --print json");
    EXPECT_EQ(refused({"--payloads", "--print", "text"}), "--payloads belongs to --print json");
}

TEST(WidgetOptions, TheHelpNamesEveryOptionAndTheExitCodes) {
    const auto help = WidgetOptions::help(80);
    for (const char* option : {"--print FORM",
                               "--payloads",
                               "--follow",
                               "--open ROW",
                               "--mode MODE",
                               "--max-rows N",
                               "--at TIME",
                               "--language TAG",
                               "--demo",
                               "--version",
                               "--help",
                               "2 wrong usage"})
        EXPECT_NE(help.find(option), std::string::npos) << option;
    EXPECT_EQ(help.rfind("Usage: orvo-transit-widget [OPTION]…\n", 0), 0U);
}

} // namespace
} // namespace orvo
