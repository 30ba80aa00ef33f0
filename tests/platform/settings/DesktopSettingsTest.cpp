#include "platform/settings/DesktopSettings.h"

#include "platform/foundation/RunLoop.h"
#include "support/ScriptedBusService.h"

#include <QDBusMetaType>
#include <gtest/gtest.h>

#include <cstdlib>
#include <memory>
#include <string>
#include <vector>

namespace orvo {
namespace {

using Settings = QMap<QString, QVariantMap>;

constexpr const char* Portal = "org.freedesktop.portal.Desktop";
constexpr const char* Interface = "org.freedesktop.portal.Settings";
constexpr const char* Common = "org.freedesktop.appearance";
constexpr const char* Gnome = "org.gnome.desktop.interface";
constexpr double Patience = 20;

/// Stands for the settings portal.
class ScriptedPortal final : public testing::ScriptedBusService {
public:
    ScriptedPortal(const std::string& address, Settings settings)
        : ScriptedBusService(address, {Portal})
        , known(std::move(settings)) {
        qDBusRegisterMetaType<Settings>();
    }

    void change(const QString& space, const QString& key, const QVariant& value) {
        known[space][key] = value;
        signal("/org/freedesktop/portal/desktop",
               Interface,
               "SettingChanged",
               {space, key, QVariant::fromValue(QDBusVariant(value))});
    }

    Settings known;
    bool answersNonsense = false;

protected:
    QVariant answerTo(const QDBusMessage& question) override {
        if (question.member() != "ReadAll" || answersNonsense)
            return QString("nonsense");
        Settings answer;
        for (const auto& space : question.arguments().value(0).toStringList()) {
            if (known.contains(space))
                answer[space] = known[space];
        }
        return QVariant::fromValue(answer);
    }
};

class DesktopSettingsTest : public ::testing::Test {
protected:
    void startPortal(const Settings& known) {
        portal = std::make_unique<ScriptedPortal>(address, known);
    }
    void follow() {
        settings.start([this](const DesktopAppearance& appearance) { told.push_back(appearance); });
    }
    bool waitFor(std::size_t times) {
        return RunLoop::main().runUntil([&] { return told.size() >= times; }, Patience);
    }

    std::string address = testing::desktopBusAddress();
    std::unique_ptr<ScriptedPortal> portal;
    DesktopSettings settings;
    std::vector<DesktopAppearance> told;
};

TEST_F(DesktopSettingsTest, TellsWhatThePortalKnows) {
    startPortal({{Common, {{"color-scheme", 1U}, {"contrast", 1U}}},
                 {Gnome, {{"text-scaling-factor", 1.25}, {"enable-animations", false}}},
                 {"org.other", {{"color-scheme", 2U}}}});
    follow();
    EXPECT_TRUE(told.empty()) << "never inside the call";
    ASSERT_TRUE(waitFor(1));
    EXPECT_EQ(
        told.at(0),
        (DesktopAppearance{
            .isDark = true, .hasHighContrast = true, .reducesMotion = true, .textScale = 1.25}));
}

TEST_F(DesktopSettingsTest, PortalWithoutSettingsIsTheUsualLooks) {
    startPortal({});
    follow();
    ASSERT_TRUE(waitFor(1));
    EXPECT_EQ(told.at(0), DesktopAppearance());
}

TEST_F(DesktopSettingsTest, CommonSettingComesBeforeTheDesktopsOwn) {
    startPortal({{Common, {{"color-scheme", 2U}}}, {Gnome, {{"color-scheme", "prefer-dark"}}}});
    follow();
    ASSERT_TRUE(waitFor(1));
    EXPECT_FALSE(told.at(0).isDark);
    portal->change(Common, "color-scheme", 0U);
    ASSERT_TRUE(waitFor(2));
    EXPECT_TRUE(told.at(1).isDark);
}

TEST_F(DesktopSettingsTest, FollowsEveryChange) {
    startPortal({});
    follow();
    ASSERT_TRUE(waitFor(1));
    portal->change(Common, "color-scheme", 1U);
    portal->change(Gnome, "text-scaling-factor", 1.5);
    portal->change(Common, "reduced-motion", 1U);
    portal->change("org.gnome.desktop.a11y.interface", "high-contrast", true);
    ASSERT_TRUE(waitFor(5));
    EXPECT_EQ(told.at(2), (DesktopAppearance{.isDark = true, .textScale = 1.5}));
    EXPECT_EQ(
        told.at(4),
        (DesktopAppearance{
            .isDark = true, .hasHighContrast = true, .reducesMotion = true, .textScale = 1.5}));
}

TEST_F(DesktopSettingsTest, WhatChangesNothingIsNotTold) {
    startPortal({{Common, {{"color-scheme", 1U}}}});
    follow();
    ASSERT_TRUE(waitFor(1));
    portal->change(Gnome, "cursor-size", 24);
    portal->change(Common, "color-scheme", 1U);
    portal->change(Gnome, "text-scaling-factor", -1.0);
    portal->change(Common, "color-scheme", 2U);
    ASSERT_TRUE(waitFor(2));
    EXPECT_EQ(told.size(), 2U);
    EXPECT_EQ(told.at(1), DesktopAppearance());
}

TEST_F(DesktopSettingsTest, PortalThatComesLaterIsAsked) {
    follow();
    RunLoop::main().runOnce();
    startPortal({{Common, {{"color-scheme", 1U}}}});
    ASSERT_TRUE(waitFor(1));
    EXPECT_TRUE(told.at(0).isDark);
}

TEST_F(DesktopSettingsTest, NonsenseIsNoAnswer) {
    startPortal({});
    portal->answersNonsense = true;
    follow();
    ASSERT_TRUE(RunLoop::main().runUntil([&] { return portal->asked > 0; }, Patience));
    portal->change(Common, "color-scheme", 1U);
    portal->answersNonsense = false;
    portal->bus.unregisterService(Portal);
    portal->bus.registerService(Portal);
    ASSERT_TRUE(waitFor(1));
    EXPECT_TRUE(told.at(0).isDark);
}

TEST_F(DesktopSettingsTest, WithoutABusItIsSilent) {
    setenv("DBUS_SESSION_BUS_ADDRESS", "disabled:", 1);
    follow();
    RunLoop::main().runOnce();
    EXPECT_TRUE(told.empty());
}

TEST_F(DesktopSettingsTest, NothingIsToldAfterItStopped) {
    startPortal({});
    follow();
    ASSERT_TRUE(waitFor(1));
    settings.stop();
    portal->change(Common, "color-scheme", 1U);
    std::vector<DesktopAppearance> other;
    DesktopSettings again;
    again.start([&](const DesktopAppearance& appearance) { other.push_back(appearance); });
    ASSERT_TRUE(RunLoop::main().runUntil([&] { return !other.empty(); }, Patience));
    EXPECT_EQ(told.size(), 1U);
}

} // namespace
} // namespace orvo
