#include "platform/settings/DesktopLanguage.h"

#include "platform/foundation/RunLoop.h"
#include "platform/foundation/Text.h"
#include "support/ScriptedBusService.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <memory>
#include <string>
#include <vector>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr const char* Localed = "org.freedesktop.locale1";
constexpr const char* LocaledPath = "/org/freedesktop/locale1";
constexpr double Patience = 20;

/// Stands for localed, which says that its property is another one, and not which.
class ScriptedLocaled final : public testing::ScriptedBusService {
public:
    ScriptedLocaled(const std::string& address, QVariant value)
        : ScriptedBusService(address, {Localed})
        , locale(std::move(value)) {}

    void change(const QVariant& value) {
        locale = value;
        propertiesChanged(LocaledPath, Localed, {}, {"Locale"});
    }

    QVariant locale;

protected:
    QVariant answerTo(const QDBusMessage&) override { return propertyAnswer(locale); }
};

class DesktopLanguageTest : public ::testing::Test {
protected:
    using Strings = std::vector<std::string>;

    void SetUp() override { forgetChoices(); }
    void TearDown() override { forgetChoices(); }
    static void forgetChoices() {
        for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANGUAGE"})
            unsetenv(variable);
    }
    void startLocaled(const QVariant& locale) {
        localed = std::make_unique<ScriptedLocaled>(address, locale);
    }
    static QVariant lang(const char* name) { return QStringList{QString("LANG=%1").arg(name)}; }
    /// Until the first question was answered.
    void follow() {
        language.start([this](const std::string& tag) { told.push_back(tag); });
        EXPECT_THAT(told, IsEmpty()) << "never inside the call";
        EXPECT_TRUE(RunLoop::main().runUntil([&] { return localed->asked > 0; }, Patience));
    }
    /// Until it was asked about; what was answered before has arrived then.
    void change(const QVariant& locale) {
        const int asked = localed->asked;
        localed->change(locale);
        EXPECT_TRUE(RunLoop::main().runUntil([&] { return localed->asked > asked; }, Patience));
    }
    bool hearsNothingOf(const QVariant& locale) {
        change(locale);
        change(locale);
        return told.empty();
    }
    bool hears(const Strings& expected) {
        return RunLoop::main().runUntil([&] { return told.size() >= expected.size(); }, Patience) &&
               std::exchange(told, {}) == expected;
    }

    std::string address = testing::desktopBusAddress();
    EnvironmentSlot<std::string>::Override english = Text::locale().overrideWith("en-US");
    std::unique_ptr<ScriptedLocaled> localed;
    DesktopLanguage language;
    Strings told;
};

TEST_F(DesktopLanguageTest, TellsWhenTheMachinesLanguageIsAnother) {
    startLocaled(lang("en_US.UTF-8"));
    follow();
    EXPECT_TRUE(hearsNothingOf(lang("en_US"))) << "the same in other words";
    change(lang("de_DE.UTF-8"));
    EXPECT_TRUE(hears({"de-DE"}));
    EXPECT_TRUE(hearsNothingOf(lang("de_DE.UTF-8"))) << "each change once";
    change(lang("en_US.UTF-8"));
    EXPECT_TRUE(hears({"en-US"})) << "and back";
}

TEST_F(DesktopLanguageTest, MessagesHaveALanguageOfTheirOwn) {
    startLocaled(lang("en_US.UTF-8"));
    follow();
    change(QStringList{"LANG=de_DE.UTF-8", "LC_TIME=fr_FR.UTF-8", "LC_MESSAGES=ar_EG.UTF-8"});
    EXPECT_TRUE(hears({"ar-EG"}));
    change(QStringList());
    EXPECT_TRUE(hears({"en"})) << "nothing set";
}

TEST_F(DesktopLanguageTest, ProgramInAnotherLanguageKeepsIt) {
    startLocaled(lang("fr_FR.UTF-8"));
    follow();
    EXPECT_TRUE(hearsNothingOf(lang("de_DE.UTF-8")));
    EXPECT_TRUE(hearsNothingOf(lang("en_US.UTF-8")));
    EXPECT_TRUE(hearsNothingOf(lang("de_DE.UTF-8"))) << "also after they were the same once";
}

TEST_F(DesktopLanguageTest, PreferenceForAnotherLanguageIsKept) {
    setenv("LANGUAGE", "fr:en", 1);
    startLocaled(lang("en_US.UTF-8"));
    follow();
    EXPECT_TRUE(hearsNothingOf(lang("de_DE.UTF-8")));
}

TEST_F(DesktopLanguageTest, PreferenceForTheSameLanguageIsNone) {
    setenv("LANGUAGE", "en_GB:en", 1);
    setenv("LC_ALL", "en_US.UTF-8", 1);
    startLocaled(lang("en_US.UTF-8"));
    follow();
    change(lang("de_DE.UTF-8"));
    EXPECT_TRUE(hears({"de-DE"}));
}

TEST_F(DesktopLanguageTest, WithoutAFirstAnswerOnlyVariablesCountAsChosen) {
    startLocaled(42); // no list of texts
    follow();
    change(lang("de_DE.UTF-8"));
    EXPECT_TRUE(hears({"de-DE"}));
    EXPECT_TRUE(hearsNothingOf(42));
}

TEST_F(DesktopLanguageTest, WhatIsChosenInTheEnvironmentIsKept) {
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANGUAGE"}) {
        forgetChoices();
        setenv(variable, "en_US.UTF-8", 1);
        startLocaled(42);
        follow();
        EXPECT_TRUE(hearsNothingOf(lang("de_DE.UTF-8"))) << variable;
        localed = nullptr;
    }
}

TEST_F(DesktopLanguageTest, ServiceThatBeginsLaterIsHeard) {
    language.start([this](const std::string& tag) { told.push_back(tag); });
    startLocaled(lang("en_US.UTF-8"));
    change(lang("de_DE.UTF-8"));
    EXPECT_TRUE(hears({"de-DE"}));
}

TEST_F(DesktopLanguageTest, TellsNothingMoreAfterItsEnd) {
    startLocaled(lang("en_US.UTF-8"));
    follow();
    language.stop();
    DesktopLanguage other;
    Strings othersTold;
    other.start([&](const std::string& tag) { othersTold.push_back(tag); });
    const int asked = localed->asked;
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return localed->asked > asked; }, Patience));
    change(lang("de_DE.UTF-8"));
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return !othersTold.empty(); }, Patience));
    EXPECT_THAT(othersTold, ElementsAre("de-DE"));
    EXPECT_THAT(told, IsEmpty());
}

TEST(DesktopLanguageWithoutABus, IsSilent) {
    setenv("DBUS_SYSTEM_BUS_ADDRESS", "unix:path=/nonexistent", 1);
    DesktopLanguage language;
    language.start({});
    RunLoop::main().runOnce();
    language.stop();
}

} // namespace
} // namespace orvo
