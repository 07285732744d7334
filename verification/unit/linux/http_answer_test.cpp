#include "linux/probe/http_answer.h"

#include <gtest/gtest.h>

namespace wp {
namespace {

constexpr std::size_t kRoom = 1000;

/// The bytes in one piece, or byte by byte, with the end of the connection after them.
HttpAnswer answerTo(const std::string& bytes, std::size_t step, std::size_t room = kRoom) {
    HttpAnswer answer(room);
    for (std::size_t at = 0; at < bytes.size(); at += step)
        answer.take(std::string_view(bytes).substr(at, step));
    answer.close();
    return answer;
}

struct Case {
    const char* what;
    std::string bytes;
    int status;  ///< 0: no answer
    std::string body;
};

const Case kCases[] = {
    {"nothing", "", 0, ""},
    {"another protocol", "SSH-2.0-OpenSSH_9.2\r\n\r\n", 0, ""},
    {"HTTP/2", "HTTP/2 200 OK\r\n\r\nx", 0, ""},
    {"a short status", "HTTP/1.1 20\r\n\r\n", 0, ""},
    {"a long status", "HTTP/1.1 2000 OK\r\n\r\n", 0, ""},
    {"no number", "HTTP/1.1 2x0 OK\r\n\r\n", 0, ""},
    {"a head that breaks off", "HTTP/1.1 200 OK\r\nA: b\r\n", 0, ""},
    {"no reason", "HTTP/1.0 302\r\n\r\n", 302, ""},
    {"counted", "HTTP/1.1 200 OK\r\nContent-Length: 3\r\n\r\nabcdef", 200, "abc"},
    {"counted twice alike", "HTTP/1.1 200 OK\r\nContent-Length: 3, 3\r\n\r\nabcd", 200, "abc"},
    {"counted twice differently", "HTTP/1.1 200 OK\r\nContent-Length: 3, 4\r\n\r\nabcd", 200, "abcd"},
    {"counted in two lines", "HTTP/1.1 200 OK\r\nContent-Length: 3\r\nContent-Length: 4\r\n\r\nabcd", 200,
     "abcd"},
    {"counted below zero", "HTTP/1.1 200 OK\r\nContent-Length: -1\r\n\r\nabcd", 200, "abcd"},
    {"counted with a sign", "HTTP/1.1 200 OK\r\nContent-Length: +1\r\n\r\nabcd", 200, "abcd"},
    {"counted with more behind it", "HTTP/1.1 200 OK\r\nContent-Length: 1x\r\n\r\nabcd", 200, "abcd"},
    {"counted beyond all", "HTTP/1.1 200 OK\r\nContent-Length: 99999999999999999999\r\n\r\nabcd", 200,
     "abcd"},
    {"cut short", "HTTP/1.1 200 OK\r\nContent-Length: 9\r\n\r\nabc", 200, "abc"},
    {"until the end", "HTTP/1.1 200 OK\r\n\r\nabc", 200, "abc"},
    {"line feeds alone", "HTTP/1.1 200 OK\nContent-Length: 1\n\nabc", 200, "a"},
    {"nothing by its status", "HTTP/1.1 204 No Content\r\nContent-Length: 3\r\n\r\nabc", 204, ""},
    {"another protocol from now on", "HTTP/1.1 101 Switching Protocols\r\n\r\nabc", 101, ""},
    {"in chunks",
     "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n3;x=\"y\"\r\nabc\r\nA\r\n0123456789\r\n0\r\nZ: "
     "z\r\n\r\n",
     200, "abc0123456789"},
    {"chunks go before a length",
     "HTTP/1.1 200 OK\r\ncontent-length: 1\r\ntransfer-encoding: gzip, Chunked\r\n\r\n2\r\nab\r\n0\r\n\r\n",
     200, "ab"},
    {"codings in two lines",
     "HTTP/1.1 200 OK\r\nTransfer-Encoding: gzip\r\nTransfer-Encoding: chunked\r\n\r\n2\r\nab\r\n0\r\n\r\n",
     200, "ab"},
    {"a chunk below zero", "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n-1\r\na\r\n", 200, ""},
    {"a page in place of chunks", "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n<html>", 200, ""},
    {"another coding lasts to the end", "HTTP/1.1 200 OK\r\nTransfer-Encoding: gzip\r\n\r\nabc", 200, "abc"},
    {"a chunk of no size", "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\nxyz\r\n", 200, ""},
    {"a chunk of every size", "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\nFFFFFFFFFFFFFFFFF\r\na",
     200, ""},
    {"a chunk that ends too late", "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n1\r\nab\r\n", 200,
     "a"},
    {"an interim answer", "HTTP/1.1 103 Early Hints\r\nLocation: /a\r\n\r\nHTTP/1.1 200 OK\r\n\r\nx", 200,
     "x"},
    {"lines that are no header", "HTTP/1.1 200 OK\r\nnonsense\r\n: x\r\n folded\r\n\r\nx", 200, "x"},
};

TEST(HttpAnswer, IsTheSameHoweverItsBytesCome) {
    for (const Case& each : kCases)
        for (const std::size_t step : {std::size_t{1}, std::size_t{7}, each.bytes.size() + 1}) {
            const HttpAnswer answer = answerTo(each.bytes, step);
            EXPECT_EQ(answer.hasHead(), each.status != 0) << each.what << " by " << step;
            EXPECT_EQ(answer.status(), each.status) << each.what << " by " << step;
            EXPECT_EQ(answer.body(), each.body) << each.what << " by " << step;
            EXPECT_TRUE(answer.ended()) << each.what << " by " << step;
        }
}

TEST(HttpAnswer, EndsWithItsLastByteAndNotWithTheConnection) {
    for (const char* bytes :
         {"HTTP/1.1 204 No Content\r\n\r\n", "HTTP/1.1 200 OK\r\nContent-Length: 0\r\n\r\n",
          "HTTP/1.1 200 OK\r\nContent-Length: 1\r\n\r\nx",
          "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n0\r\n"}) {
        HttpAnswer answer(kRoom);
        const std::string_view all = bytes;
        answer.take(all.substr(0, all.size() - 1));
        EXPECT_FALSE(answer.ended()) << bytes;
        answer.take(all.substr(all.size() - 1));
        EXPECT_TRUE(answer.ended()) << bytes;
    }
}

TEST(HttpAnswer, TellsAnEmptyPageFromOneThatDidNotCome) {
    const struct {
        const char* headers;
        bool isWhole;
        std::size_t size;
    } cases[] = {{"Content-Length: 0\r\n\r\n", true, 0},
                 {"\r\n", true, 0},
                 {"\r\nabc", true, 3},
                 {"Transfer-Encoding: chunked\r\n\r\n0\r\n", true, 0},
                 {"Transfer-Encoding: chunked\r\n\r\n", false, 0},
                 {"Transfer-Encoding: chunked\r\n\r\n<html>\r\n", false, 0},
                 {"Content-Length: 500\r\n\r\n", false, 0},
                 {"Content-Length: 5000\r\n\r\nabc", false, 3},
                 {"Content-Length: x\r\n\r\nabc", true, 3}};
    for (const auto& each : cases) {
        const HttpAnswer answer = answerTo(std::string("HTTP/1.1 200 OK\r\n") + each.headers, 9);
        EXPECT_EQ(answer.isWhole(), each.isWhole) << each.headers;
        EXPECT_EQ(answer.body().size(), each.size) << each.headers;
    }
}

TEST(HttpAnswer, WithoutALengthIsWholeOnlyWhereTheConnectionEndsInOrder) {
    const auto brokenOff = [](const char* rest) {
        HttpAnswer answer(kRoom);
        answer.take(std::string("HTTP/1.1 200 OK\r\n") + rest);
        answer.breakOff();
        return answer;
    };
    for (const char* rest : {"\r\n", "\r\nabc", "Content-Length: 4\r\n\r\nabc",
                             "Transfer-Encoding: chunked\r\n\r\n3\r\nabc\r\n"}) {
        EXPECT_TRUE(brokenOff(rest).ended()) << rest;
        EXPECT_TRUE(brokenOff(rest).hasHead()) << rest;
        EXPECT_FALSE(brokenOff(rest).isWhole()) << rest;
    }
    for (const char* rest :
         {"Content-Length: 3\r\n\r\nabc", "Transfer-Encoding: chunked\r\n\r\n3\r\nabc\r\n0\r\n\r\n"})
        EXPECT_TRUE(brokenOff(rest).isWhole()) << rest;
    EXPECT_EQ(brokenOff("\r\nabc").body(), "abc");
}

TEST(HttpAnswer, FindsAHeaderWhateverItsCaseTheFirstOfSeveral) {
    const HttpAnswer answer = answerTo(
        "HTTP/1.1 302 Found\r\nLOCATION :\t http://a/b \r\nLocation: /c\r\nX-Long: one\r\n\t "
        "two\r\nEmpty:\r\n\r\n",
        5);
    EXPECT_EQ(answer.header("location"), "http://a/b");
    EXPECT_EQ(answer.header("x-long"), "one two");
    EXPECT_EQ(answer.header("Empty"), "");
    EXPECT_EQ(answer.header("Missing"), "");
}

TEST(HttpAnswer, IsBoundedWhateverAServerSends) {
    const std::string start = "HTTP/1.1 200 OK\r\n",
                      counted = "HTTP/1.1 200 OK\r\nContent-Length: 999999\r\n\r\n";
    std::string manyHeaders = start, manyInterim;
    while (manyHeaders.size() < (64U << 10)) manyHeaders += "A: b\r\n";
    for (int i = 0; i < 9; ++i) manyInterim += "HTTP/1.1 100 Continue\r\n\r\n";
    const std::string longLine = start + "A: " + std::string(16U << 10, 'x');
    const std::string longChunkLine =
        start + "Transfer-Encoding: chunked\r\n\r\n1;" + std::string(300, 'x') + "\r\na\r\n0\r\n";

    EXPECT_FALSE(answerTo(manyHeaders + "\r\nx", 4096).hasHead());
    EXPECT_FALSE(answerTo(manyInterim + start + "\r\nx", 4096).hasHead());
    EXPECT_FALSE(answerTo(longLine + "\r\n\r\nx", 4096).hasHead());
    EXPECT_EQ(answerTo(longChunkLine, 4096).body(), "");
    EXPECT_EQ(answerTo(counted + std::string(5000, 'x'), 100).body().size(), kRoom);
}

TEST(HttpAnswer, ReadsADateInEachOfItsForms) {
    constexpr std::int64_t kMoment = 784111777;
    EXPECT_EQ(httpDate("Sun, 06 Nov 1994 08:49:37 GMT"), kMoment);
    EXPECT_EQ(httpDate("Sunday, 06-Nov-94 08:49:37 GMT"), kMoment);
    EXPECT_EQ(httpDate("Sun Nov  6 08:49:37 1994"), kMoment);
    for (const std::string& text :
         {std::string(), std::string("yesterday"), std::string("Sun, 06 Nov 1994 08:49:37"),
          std::string("Sun, 06 Nov 1994 08:49:37 GMT and more"),
          std::string("Sun, 06 Nov 1994 08:49:37 GMT\0more", 34)})
        EXPECT_EQ(httpDate(text), std::nullopt) << text;
}

}  // namespace
}  // namespace wp
