#include "platform/extension/NSExtensionMain.h"

#include "platform/foundation/NSBundle.h"
#include "platform/launchservices/BundleProxy.h"
#include "platform/launchservices/PlugInKitProxy.h"
#include "platform/uikit/UIViewController.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

class NSExtensionMainTest : public ::testing::Test {
protected:
    NSExtensionMainTest() {
        std::ofstream(folder.path() / "Info.plist")
            << "\"BundleIdentifier\" = \"a.widget\"; \"ContainingApplication\" = \"a.map\";"
               "\"DisplayName\" = \"A\"; \"NSExtensionPrincipalClass\" = \"Principal\";";
    }
    static int runProgram() {
        char name[] = "/somewhere/program";
        char first[] = "--one";
        char second[] = "";
        char* arguments[] = {name, first, second, nullptr};
        return NSExtensionMain(3, arguments);
    }

    testing::TemporaryFolder folder;
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override bundle =
        NSBundle::main().overrideWith(NSBundle::bundleWithPath(folder.path()));
    EnvironmentSlot<PrincipalClassTable>::Override classes = principalClasses().overrideWith(
        {{"Principal", [] {
              return UIViewController::initWithNibName_bundle({}, nullptr);
          }}});
    EnvironmentSlot<std::shared_ptr<BundleProxy>>::Override process =
        BundleProxy::currentProcess().overrideWith(nullptr);
};

TEST_F(NSExtensionMainTest, HandsTheExtensionAndTheArgumentsToTheHost) {
    std::vector<std::string> given;
    std::string principalClass;
    const auto host = extensionHostProgram().overrideWith(
        [&](const Extension& extension, const std::vector<std::string>& arguments) {
            given = arguments;
            principalClass = extension.description().principalClass;
            return 7;
        });
    EXPECT_EQ(runProgram(), 7);
    EXPECT_EQ(given, (std::vector<std::string>{"--one", ""}));
    EXPECT_EQ(principalClass, "Principal");
}

TEST_F(NSExtensionMainTest, SaysWhatTheProcessIs) {
    const auto host =
        extensionHostProgram().overrideWith([](const Extension&, const auto&) { return 0; });
    EXPECT_EQ(runProgram(), 0);
    const auto proxy =
        std::dynamic_pointer_cast<PlugInKitProxy>(BundleProxy::bundleProxyForCurrentProcess());
    ASSERT_NE(proxy, nullptr);
    EXPECT_EQ(proxy->bundleIdentifier(), "a.widget");
    EXPECT_EQ(proxy->containingBundle()->bundleIdentifier(), "a.map");
}

TEST_F(NSExtensionMainTest, WithoutAPrincipalClassItFailsWithTheReason) {
    const auto none = principalClasses().overrideWith({});
    ::testing::internal::CaptureStderr();
    EXPECT_EQ(runProgram(), 1);
    EXPECT_EQ(::testing::internal::GetCapturedStderr(),
              "program: " + (folder.path() / "Info.plist").string() +
                  ": this program has no class Principal\n");
}

TEST_F(NSExtensionMainTest, WithoutAHostItFails) {
    ::testing::internal::CaptureStderr();
    EXPECT_EQ(runProgram(), 1);
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "program: there is no host to run it\n");
}

TEST_F(NSExtensionMainTest, WhatAHostThrowsIsSaid) {
    const auto host = extensionHostProgram().overrideWith(
        [](const Extension&, const auto&) -> int { throw std::runtime_error("no luck"); });
    ::testing::internal::CaptureStderr();
    EXPECT_EQ(runProgram(), 1);
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "program: no luck\n");
}

} // namespace
} // namespace orvo
