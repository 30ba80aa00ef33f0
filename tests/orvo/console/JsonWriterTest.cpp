#include "orvo/console/JsonWriter.h"

#include <gtest/gtest.h>

#include <cmath>

namespace orvo {
namespace {

TEST(JsonWriter, WritesMembersInTheOrderGiven) {
    JsonWriter json;
    json.beginObject();
    json.key("b").value("text");
    json.key("a").beginArray().value(std::int64_t{-1}).value(true).null().endArray();
    json.key("empty").beginArray().endArray();
    json.key("none").value(std::optional<std::string>());
    json.endObject();
    EXPECT_EQ(json.text(),
              "{\n"
              "  \"b\": \"text\",\n"
              "  \"a\": [\n"
              "    -1,\n"
              "    true,\n"
              "    null\n"
              "  ],\n"
              "  \"empty\": [],\n"
              "  \"none\": null\n"
              "}\n");
}

TEST(JsonWriter, WritesADocumentInOneLineForReadersOfLines) {
    JsonWriter json(JsonWriter::Layout::OneLine);
    json.beginObject().key("a").value("x\ny").key("b").beginArray();
    json.value(std::int64_t{1}).value(std::int64_t{2}).endArray().endObject();
    EXPECT_EQ(json.text(), "{\"a\": \"x\\ny\", \"b\": [1, 2]}\n");
}

TEST(JsonWriter, EscapesWhatMustBeEscaped) {
    JsonWriter json;
    json.value("a\"b\\c\nd\te\x01 ü 東 \u2028");
    EXPECT_EQ(json.text(), "\"a\\\"b\\\\c\\nd\\u0009e\\u0001 ü 東 \\u2028\"\n");
}

TEST(JsonWriter, BytesThatAreNotTextDoNotSpoilTheDocument) {
    JsonWriter json;
    json.value("a\xFF\xC3");
    EXPECT_EQ(json.text(), "\"a\xEF\xBF\xBD\xEF\xBF\xBD\"\n");
}

TEST(JsonWriter, NumbersReadAsTheSameNumber) {
    JsonWriter json;
    json.beginArray().value(54.3821).value(0.1).value(2.0).value(std::nan("")).endArray();
    EXPECT_EQ(json.text(), "[\n  54.3821,\n  0.1,\n  2,\n  null\n]\n");
}

TEST(JsonWriter, TextLiteralsAreNoTruthValues) {
    JsonWriter json;
    json.value("x");
    EXPECT_EQ(json.text(), "\"x\"\n");
}

} // namespace
} // namespace orvo
