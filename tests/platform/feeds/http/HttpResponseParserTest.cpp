#include "platform/feeds/http/HttpResponseParser.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Failure = HttpAnswer::Failure;

constexpr std::uint64_t Limit = 1000;

std::vector<std::uint8_t> block(std::string_view text) {
    return {text.begin(), text.end()};
}

/// The answer to bytes after which the connection ends, given in pieces of `step`.
HttpAnswer answerTo(const std::string& bytes, std::size_t step = 1000) {
    HttpResponseParser parser(Limit);
    for (std::size_t at = 0; at < bytes.size(); at += step)
        parser.feed(block(std::string_view(bytes).substr(at, step)));
    parser.endOfConnection();
    EXPECT_TRUE(parser.isComplete());
    return parser.takeAnswer();
}

std::string bodyOf(const HttpAnswer& answer) {
    return answer.failure == Failure::None ? std::string(answer.body->stringView())
                                           : "(" + answer.reason + ")";
}

const std::string Plain = "HTTP/1.1 200 OK\r\nETag: \"1\"\r\nContent-Length: 4\r\n\r\nbody";
const std::string Chunked = "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n"
                            "2\r\nbo\r\n02;x=y\r\ndy\r\n0\r\nTrailer: x\r\n\r\n";

TEST(HttpResponseParser, StatusHeadersAndBody) {
    const auto answer = answerTo(Plain);
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(answer.header("etag"), "\"1\"");
    EXPECT_EQ(answer.header("content-length"), "4");
    EXPECT_EQ(answer.header("server"), "");
    EXPECT_EQ(bodyOf(answer), "body");
}

TEST(HttpResponseParser, ChunksArePutTogether) {
    EXPECT_EQ(bodyOf(answerTo(Chunked)), "body");
}

TEST(HttpResponseParser, PiecesOfAnySizeReadAlike) {
    for (std::size_t step = 1; step < Chunked.size(); ++step) {
        EXPECT_EQ(bodyOf(answerTo(Plain, step)), "body") << step;
        EXPECT_EQ(bodyOf(answerTo(Chunked, step)), "body") << step;
    }
}

TEST(HttpResponseParser, CutAnywhereItIsAFailure) {
    for (const auto* whole : {&Plain, &Chunked})
        for (std::size_t length = 0; length < whole->size(); ++length)
            EXPECT_NE(answerTo(whole->substr(0, length)).failure, Failure::None)
                << whole->substr(0, length);
}

TEST(HttpResponseParser, CompleteWithoutTheConnectionsEnd) {
    for (const auto* whole : {&Plain, &Chunked}) {
        HttpResponseParser parser(Limit);
        const auto bytes = block(*whole);
        parser.feed(std::span(bytes).first(bytes.size() - 1));
        EXPECT_FALSE(parser.isComplete());
        parser.feed(std::span(bytes).last(1));
        EXPECT_TRUE(parser.isComplete());
        parser.feed(block("more"));
        EXPECT_EQ(bodyOf(parser.takeAnswer()), "body");
    }
}

TEST(HttpResponseParser, WithoutALengthTheBodyEndsWithTheConnection) {
    EXPECT_EQ(bodyOf(answerTo("HTTP/1.0 200\n\nbody")), "body");
    EXPECT_EQ(bodyOf(answerTo("HTTP/1.1 200 OK\r\n\r\n")), "");
}

TEST(HttpResponseParser, TellsABodysEndThatIsToldFromOneThatIsNot) {
    EXPECT_TRUE(answerTo(Plain).isEndTold);
    EXPECT_TRUE(answerTo(Chunked).isEndTold);
    EXPECT_TRUE(answerTo("HTTP/1.1 200 OK\r\nContent-Length: 0\r\n\r\n").isEndTold);
    EXPECT_TRUE(answerTo("HTTP/1.1 304 Not Modified\r\n\r\n").isEndTold);
    EXPECT_FALSE(answerTo("HTTP/1.0 200\n\nbody").isEndTold);
    EXPECT_FALSE(answerTo("HTTP/1.1 200 OK\r\nContent-Encoding: gzip\r\n\r\n").isEndTold);
}

TEST(HttpResponseParser, ChunksGoBeforeALength) {
    EXPECT_EQ(bodyOf(answerTo("HTTP/1.1 200 OK\r\nContent-Length: 3\r\nTransfer-Encoding: "
                              "Chunked\r\n\r\n4\r\nbody\r\n0\r\n\r\n")),
              "body");
}

TEST(HttpResponseParser, HeadersInTheirStrangerForms) {
    const auto answer = answerTo("HTTP/1.1 200 OK\r\nX-A:1\r\nx-b :  two \t\r\n\tthree\r\n"
                                 "X-A: 2\r\nEmpty:\r\nContent-Length: 0\r\n\r\n");
    EXPECT_EQ(answer.failure, Failure::None);
    EXPECT_EQ(answer.header("x-a"), "1");
    EXPECT_EQ(answer.header("x-b"), "two three");
    EXPECT_EQ(answer.header("empty"), "");
}

TEST(HttpResponseParser, AnswersOnTheWayArePassedOver) {
    const auto answer = answerTo("HTTP/1.1 103 Early Hints\r\nETag: \"0\"\r\n\r\n" + Plain);
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(answer.header("etag"), "\"1\"");
}

TEST(HttpResponseParser, TheBodyOfNoSuccessIsNotWaitedFor) {
    for (const int status : {204, 301, 304, 404, 503}) {
        HttpResponseParser parser(Limit);
        parser.feed(
            block("HTTP/1.1 " + std::to_string(status) + " x\r\nContent-Length: 9999999\r\n\r\n"));
        EXPECT_TRUE(parser.isComplete()) << status;
        const auto answer = parser.takeAnswer();
        EXPECT_EQ(answer.status, status);
        EXPECT_EQ(bodyOf(answer), "");
    }
}

TEST(HttpResponseParser, TheLimitIsTheLastThatFits) {
    const std::string fits(Limit, 'x');
    const std::string head = "HTTP/1.1 200 OK\r\n";
    EXPECT_EQ(bodyOf(answerTo(head + "Content-Length: 1000\r\n\r\n" + fits)), fits);
    EXPECT_EQ(bodyOf(answerTo(head + "\r\n" + fits)), fits);
    const std::string chunks = "Transfer-Encoding: chunked\r\n\r\n";
    EXPECT_EQ(bodyOf(answerTo(head + chunks + "3e8\r\n" + fits + "\r\n0\r\n\r\n")), fits);
    for (const auto& beyond : {head + "Content-Length: 1001\r\n\r\n",
                               head + "\r\n" + fits + "x",
                               head + chunks + "3e8\r\n" + fits + "\r\n1\r\nx\r\n0\r\n\r\n",
                               head + chunks + "ffffffffffffffff\r\n" + fits + "x"}) {
        const auto answer = answerTo(beyond);
        EXPECT_EQ(answer.failure, Failure::TooLarge);
        EXPECT_EQ(answer.reason, "larger than 1000 bytes");
    }
}

TEST(HttpResponseParser, HeadersWithoutAnEndAreAFailure) {
    const std::string many(HttpResponseParser::LongestHead, 'x');
    EXPECT_EQ(answerTo("HTTP/1.1 200 OK\r\nX: " + many).failure, Failure::Incomplete);
    std::string informal;
    for (std::size_t size = 0; size <= HttpResponseParser::LongestHead; size = informal.size())
        informal += "HTTP/1.1 100 Go on\r\n\r\n";
    EXPECT_EQ(answerTo(informal + Plain).failure, Failure::Incomplete);
    EXPECT_EQ(
        answerTo("HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n0\r\nX: " + many).failure,
        Failure::Incomplete);
}

TEST(HttpResponseParser, OtherLanguagesAreNoAnswer) {
    for (const char* bytes : {"220 mail.example ESMTP\r\n",
                              "SSH-2.0-x\r\n",
                              "\r\nHTTP/1.1 200 OK\r\n\r\n",
                              "HTTP/2 200 OK\r\n\r\n",
                              "HTTP/1.1 20 OK\r\n\r\n",
                              "HTTP/1.1 2000 OK\r\n\r\n",
                              "HTTP/1.1 099 OK\r\n\r\n",
                              "HTTP/1.1 abc OK\r\n\r\n",
                              "HTTP/1.1 200 OK\r\nno header\r\n\r\n",
                              "HTTP/1.1 200 OK\r\n: x\r\n\r\n",
                              "HTTP/1.1 200 OK\r\n folded\r\n\r\n"}) {
        const auto answer = answerTo(bytes);
        EXPECT_EQ(answer.failure, Failure::Unreachable) << bytes;
        EXPECT_EQ(answer.reason, "what answers there is no web server");
    }
}

TEST(HttpResponseParser, ALengthThatIsNoneOrTwoIsAFailure) {
    for (const char* lengths : {"Content-Length: 4\r\nContent-Length: 5\r\n",
                                "Content-Length: -4\r\n",
                                "Content-Length: 4, 4\r\n",
                                "Content-Length: 99999999999999999999\r\n",
                                "Content-Length: 0x4\r\n",
                                "Content-Length:\r\n"})
        EXPECT_EQ(answerTo(std::string("HTTP/1.1 200 OK\r\n") + lengths + "\r\nbody").failure,
                  Failure::Incomplete)
            << lengths;
    EXPECT_EQ(
        bodyOf(answerTo("HTTP/1.1 200 OK\r\nContent-Length: 4\r\nContent-Length: 4\r\n\r\nbody")),
        "body");
}

TEST(HttpResponseParser, ChunksThatDoNotFitAreAFailure) {
    const std::string head = "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n";
    for (const char* chunks : {"x\r\nbody\r\n0\r\n\r\n",
                               "\r\nbody\r\n0\r\n\r\n",
                               "-4\r\nbody\r\n0\r\n\r\n",
                               "3\r\nbody\r\n0\r\n\r\n",
                               "10000000000000004\r\nbody\r\n0\r\n\r\n"})
        EXPECT_EQ(answerTo(head + chunks).failure, Failure::Incomplete) << chunks;
    EXPECT_EQ(answerTo("HTTP/1.1 200 OK\r\nTransfer-Encoding: gzip\r\n\r\nbody").failure,
              Failure::Incomplete);
}

} // namespace
} // namespace orvo
