#include "platform/extension/HeadlessApplication.h"

#include "platform/foundation/RunLoop.h"
#include "support/LogCapture.h"

#include <QGuiApplication>
#include <gtest/gtest.h>

namespace orvo {
namespace {

/// Whoever comes first in a process makes its application object, so CTest's processes count.
class HeadlessApplicationTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (QCoreApplication::instance())
            GTEST_SKIP() << "another test has made the application object";
    }
};

TEST_F(HeadlessApplicationTest, NeedsNoScreenWhateverTheEnvironmentNames) {
    setenv("QT_QPA_PLATFORM", "no such platform", 1);
    setenv("DISPLAY", ":64999", 1);
    makeHeadlessApplication();
    EXPECT_EQ(QGuiApplication::platformName(), "offscreen");
    auto* const made = QCoreApplication::instance();
    makeHeadlessApplication();
    EXPECT_EQ(QCoreApplication::instance(), made) << "once is enough";
}

TEST_F(HeadlessApplicationTest, IsTheOneThatTheRunLoopStandsOn) {
    makeHeadlessApplication();
    bool ran = false;
    EXPECT_TRUE(RunLoop::main().runUntil([&] { return std::exchange(ran, true); }, 60));
    EXPECT_NE(qobject_cast<QGuiApplication*>(QCoreApplication::instance()), nullptr);
}

TEST_F(HeadlessApplicationTest, WhatTheToolkitRemarksIsLogged) {
    makeHeadlessApplication();
    const testing::LogCapture log;
    ::testing::internal::CaptureStderr();
    qWarning("it is dark in here");
    qCritical("it is very dark");
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "");
    const auto records = log.records();
    ASSERT_EQ(records.size(), 2U);
    EXPECT_EQ(records[0].category, "Toolkit");
    EXPECT_EQ(records[0].level, LogLevel::Debug);
    EXPECT_EQ(records[0].message, "it is dark in here");
    EXPECT_EQ(records[1].level, LogLevel::Error);
}

} // namespace
} // namespace orvo
