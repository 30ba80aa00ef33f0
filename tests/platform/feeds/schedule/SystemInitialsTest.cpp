#include "platform/feeds/schedule/SystemInitials.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(SystemInitials, AreTheFirstLettersOfTheWordsAtMostThree) {
    EXPECT_EQ(systemInitials("Detroit People Mover"), "DPM");
    EXPECT_EQ(systemInitials("Cape Cod Regional Transit Authority"), "CCR");
    EXPECT_EQ(systemInitials("Agency One"), "AO");
}

TEST(SystemInitials, PassSmallWordsOverWhereOthersAreNot) {
    EXPECT_EQ(systemInitials("Société des Transports de l'Ouest"), "STO");
    EXPECT_EQ(systemInitials("King's Lines"), "KL");
    EXPECT_EQ(systemInitials("trains of the north"), "TOT");
}

TEST(SystemInitials, OfOneWordAreItsCapitalsOrItsFirstLetter) {
    EXPECT_EQ(systemInitials("MiWay"), "MW");
    EXPECT_EQ(systemInitials("TAM"), "TAM");
    EXPECT_EQ(systemInitials("MBTA"), "MBT");
    EXPECT_EQ(systemInitials("Metro"), "M");
    EXPECT_EQ(systemInitials("metro"), "M");
    EXPECT_EQ(systemInitials("östtrafik"), "Ö");
    EXPECT_EQ(systemInitials("東京都交通局"), "東");
}

TEST(SystemInitials, AreEmptyWithoutLettersAndDigits) {
    EXPECT_EQ(systemInitials(""), "");
    EXPECT_EQ(systemInitials(" - "), "");
}

} // namespace
} // namespace orvo
