#include "orvo/console/LanguageTag.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(LanguageTag, IsALanguageAndWhatNarrowsIt) {
    for (const char* tag : {"de", "DE", "gsw", "pt-BR", "pt_BR", "zh-Hant-TW", "es-419", "de-1996"})
        EXPECT_TRUE(isLanguageTag(tag)) << tag;
}

TEST(LanguageTag, IsNothingElse) {
    for (const char* tag : {"",
                            "%%",
                            "d",
                            "1e",
                            "de-",
                            "-de",
                            "de--AT",
                            "de AT",
                            "de.UTF-8",
                            "dé",
                            "overlonglanguage",
                            "de-overlongpart"})
        EXPECT_FALSE(isLanguageTag(tag)) << tag;
}

} // namespace
} // namespace orvo
