#include "platform/extension/Extension.h"

#include "platform/uikit/UIViewController.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

constexpr const char* Whole = "\"BundleIdentifier\" = \"a.widget\";\n"
                              "\"ContainingApplication\" = \"a.map\";\n"
                              "\"DisplayName\" = \"A Widget\";\n"
                              "\"NSExtensionPrincipalClass\" = \"Principal\";\n";

class ExtensionTest : public ::testing::Test {
protected:
    void write(const std::string& text) const { std::ofstream(file()) << text; }
    std::filesystem::path file() const { return folder.path() / "Info.plist"; }
    std::string messageOfFailure(ExtensionErrorCode code) const {
        std::shared_ptr<NSError> error;
        EXPECT_FALSE(Extension::extensionInFolder(folder.path(), &error));
        if (!error)
            return "no error";
        EXPECT_EQ(error->domain(), ExtensionErrorDomain);
        EXPECT_EQ(error->code(), static_cast<std::int64_t>(code));
        return error->localizedDescription();
    }

    testing::TemporaryFolder folder;
    EnvironmentSlot<PrincipalClassTable>::Override classes = principalClasses().overrideWith(
        {{"Principal", [] {
              return UIViewController::initWithNibName_bundle({}, nullptr);
          }}});
};

TEST_F(ExtensionTest, IsWhatItsDescriptionSays) {
    write(std::string(Whole) + "\"IconName\" = \"good-v2\";\n");
    std::shared_ptr<NSError> error;
    const auto extension = Extension::extensionInFolder(folder.path(), &error);
    ASSERT_TRUE(extension) << error->localizedDescription();
    EXPECT_EQ(extension->description().bundleIdentifier, "a.widget");
    EXPECT_EQ(extension->description().containingApplication, "a.map");
    EXPECT_EQ(extension->description().displayName, "A Widget");
    EXPECT_EQ(extension->description().principalClass, "Principal");
    EXPECT_EQ(extension->description().iconName, "good-v2");
    EXPECT_NE(extension->makePrincipalObject(), extension->makePrincipalObject());
}

TEST_F(ExtensionTest, NeedsNoIcon) {
    write(Whole);
    EXPECT_EQ(Extension::extensionInFolder(folder.path(), nullptr)->description().iconName,
              std::nullopt);
}

TEST_F(ExtensionTest, AMissingDescriptionIsNamed) {
    EXPECT_EQ(messageOfFailure(ExtensionErrorCode::NoDescription),
              file().string() + ": No such file or directory");
}

TEST_F(ExtensionTest, AFolderInItsPlaceIsNoDescription) {
    std::filesystem::create_directory(file());
    EXPECT_EQ(messageOfFailure(ExtensionErrorCode::NoDescription),
              file().string() + ": Is a directory");
}

TEST_F(ExtensionTest, AWrongDescriptionIsNamedWithItsPlace) {
    write("\"BundleIdentifier\" =\n\n");
    EXPECT_EQ(messageOfFailure(ExtensionErrorCode::WrongDescription).find(file().string() + ": "),
              0U);
}

TEST_F(ExtensionTest, EveryEntryIsNeeded) {
    const std::string whole = Whole;
    for (const std::string key : {"BundleIdentifier",
                                  "ContainingApplication",
                                  "DisplayName",
                                  "NSExtensionPrincipalClass"}) {
        const auto start = whole.find('"' + key);
        write(whole.substr(0, start) + whole.substr(whole.find('\n', start) + 1));
        EXPECT_EQ(messageOfFailure(ExtensionErrorCode::WrongDescription),
                  file().string() + ": has no entry " + key);
    }
}

TEST_F(ExtensionTest, AClassThatTheProgramLacksIsNamed) {
    write(Whole);
    const auto none = principalClasses().overrideWith({});
    EXPECT_EQ(messageOfFailure(ExtensionErrorCode::NoPrincipalClass),
              file().string() + ": this program has no class Principal");
}

TEST_F(ExtensionTest, TheProgramsOwnDescriptionCanBeRead) {
    std::shared_ptr<NSError> error;
    const auto own = ExtensionDescription::read(
        std::filesystem::path(ORVO_TEST_RESOURCES) / ExtensionDescription::FileName, &error);
    ASSERT_TRUE(own) << error->localizedDescription();
    EXPECT_EQ(own->principalClass, "OWTransitIncidentsViewController");
}

} // namespace
} // namespace orvo
