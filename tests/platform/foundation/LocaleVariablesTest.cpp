#include "platform/foundation/LocaleVariables.h"

#include <gtest/gtest.h>

#include <map>

namespace orvo {
namespace {

std::string localeOf(const std::map<std::string, std::string>& variables) {
    return localeOfVariables([&](const std::string& variable) -> std::optional<std::string> {
        const auto found = variables.find(variable);
        return found == variables.end() ? std::nullopt : std::optional<std::string>(found->second);
    });
}

TEST(LocaleVariables, AreReadInTheirOrder) {
    EXPECT_EQ(localeOf({{"LANG", "de_DE"}, {"LC_MESSAGES", "fr_FR"}, {"LC_ALL", "pl_PL"}}),
              "pl-PL");
    EXPECT_EQ(localeOf({{"LANG", "de_DE"}, {"LC_MESSAGES", "fr_FR"}, {"LC_ALL", ""}}), "fr-FR");
    EXPECT_EQ(localeOf({{"LANG", "de_DE"}, {"LC_TIME", "fr_FR"}}), "de-DE");
}

TEST(LocaleVariables, EncodingAndVariantDoNotCount) {
    EXPECT_EQ(localeOf({{"LANG", "de_CH.UTF-8@euro"}}), "de-CH");
    EXPECT_EQ(localeOf({{"LANG", "ca_ES@valencia"}}), "ca-ES");
}

TEST(LocaleVariables, NoneAndTheMachinesOwnAreEnglish) {
    EXPECT_EQ(localeOf({}), "en");
    EXPECT_EQ(localeOf({{"LANG", "C.UTF-8"}}), "en");
    EXPECT_EQ(localeOf({{"LC_ALL", "POSIX"}, {"LANG", "de_DE"}}), "en");
}

} // namespace
} // namespace orvo
