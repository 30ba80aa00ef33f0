#include "platform/feeds/alerts/SourceProof.h"

#include "AlertMaker.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

constexpr double Now = 1750000000;

SourceProof
judge(const std::string& bytes, double fetchedAt, std::shared_ptr<NSError> error = nullptr) {
    // The proof views the bytes: they stay for the test's process.
    static std::vector<std::shared_ptr<NSData>> kept;
    kept.push_back(NSData::dataWithString(bytes));
    return SourceProof::judge({kept.back(), fetchedAt, std::move(error)}, Now);
}

std::string good(std::uint64_t timestamp = 1750000000) {
    return message(std::vector<AlertMaker>(1), timestamp);
}

AlertErrorCode codeOf(const SourceProof& proof) {
    return static_cast<AlertErrorCode>(proof.error->code());
}

} // namespace

TEST(SourceProof, AWholeFreshMessageProvesSomething) {
    const SourceProof proof = judge(good(), Now);
    ASSERT_TRUE(proof.message);
    EXPECT_EQ(proof.error, nullptr);
    EXPECT_EQ(proof.headerTime, Now);
    EXPECT_EQ(proof.lastKnown, Now);
}

TEST(SourceProof, ALastGoodBodyHoldsForTenMinutesThoughTheLatestAttemptFailed) {
    const auto error = NSError::errorWithMessage("net", 1, "it timed out");
    EXPECT_TRUE(judge(good(), Now - 600, error).message);
    const SourceProof old = judge(good(), Now - 601, error);
    EXPECT_FALSE(old.message);
    EXPECT_EQ(codeOf(old), AlertErrorCode::TooOld);
    EXPECT_EQ(old.error->localizedDescription(), "it timed out");
    EXPECT_EQ(old.lastKnown, Now - 601);
}

TEST(SourceProof, NothingEverGotProvesNothing) {
    const SourceProof proof =
        SourceProof::judge({nullptr, 0, NSError::errorWithMessage("net", 1, "no such host")}, Now);
    EXPECT_EQ(codeOf(proof), AlertErrorCode::NotFetched);
    EXPECT_EQ(proof.error->localizedDescription(), "no such host");
    EXPECT_EQ(proof.lastKnown, std::nullopt);
    EXPECT_EQ(SourceProof::judge({}, Now).error->localizedDescription(), "it was never fetched");
}

TEST(SourceProof, BytesThatAreNoMessageProveNothing) {
    const SourceProof proof = judge("<html>", Now);
    EXPECT_FALSE(proof.message);
    EXPECT_EQ(codeOf(proof), AlertErrorCode::NotAlerts);
    EXPECT_EQ(proof.lastKnown, std::nullopt);
}

TEST(SourceProof, AMessageOfMoreThanADayAgoProvesNothing) {
    EXPECT_TRUE(judge(good(1750000000 - 86400), Now).message);
    const SourceProof stale = judge(good(1750000000 - 86401), Now);
    EXPECT_FALSE(stale.message);
    EXPECT_EQ(codeOf(stale), AlertErrorCode::Stale);
    EXPECT_EQ(stale.lastKnown, Now - 86401);
}

TEST(SourceProof, AHeaderWithoutATimeOrInTheFutureHasThatOfTheFetch) {
    EXPECT_EQ(judge(good(0), Now - 60).headerTime, Now - 60);
    EXPECT_EQ(judge(good(1750000500), Now - 60).headerTime, Now - 60);
}

TEST(SourceProof, ABodyOfTheFutureProvesNothingBeyondAMinute) {
    // A clock that was set back; a body of any age would look fresh.
    EXPECT_TRUE(judge(good(), Now + 60).message);
    const SourceProof future = judge(good(), Now + 61);
    EXPECT_FALSE(future.message);
    EXPECT_EQ(codeOf(future), AlertErrorCode::TooOld);
    EXPECT_EQ(future.error->localizedDescription(),
              "it was last fetched at a time that has not come yet");
    EXPECT_EQ(future.lastKnown, Now);
}

TEST(SourceProof, AMessageOfMereDifferencesProvesNothing) {
    const Wire header = Wire().bytes(1, "2.0").number(2, 1).number(3, 1750000000);
    EXPECT_EQ(codeOf(judge(Wire().bytes(1, header).str(), Now)), AlertErrorCode::Difference);
}

} // namespace orvo::testing
