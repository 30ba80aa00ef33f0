#include "shared/OrvoMap.h"

#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSOrderedSet.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace orvo {
namespace {

using Object = std::shared_ptr<NSObject>;

NSArray::Elements texts(std::initializer_list<const char*> values) {
    NSArray::Elements elements;
    for (const char* value : values)
        elements.push_back(NSString::string(value));
    return elements;
}

std::vector<std::string> textsIn(const std::shared_ptr<NSArray>& array) {
    std::vector<std::string> values;
    for (const auto& text : typed<NSString>(array))
        values.push_back(text->utf8());
    return values;
}

/// Answers what it is given, and remembers element and index.
struct Recorder {
    std::vector<std::string> elements;
    std::vector<std::size_t> indexes;

    auto block() {
        return [this](const Object& element, std::size_t index) {
            elements.push_back(*stringValue(element.get()));
            indexes.push_back(index);
            return element;
        };
    }
};

TEST(OrvoMap, OfNilIsNilAndCallsNothing) {
    Recorder recorder;
    EXPECT_EQ(OrvoMap(nullptr, recorder.block()), nullptr);
    EXPECT_TRUE(recorder.elements.empty());
}

TEST(OrvoMap, OfAnEmptyCollectionIsEmptyAndNotNil) {
    Recorder recorder;
    const auto result = OrvoMap(NSArray::array(), recorder.block());
    ASSERT_TRUE(result);
    EXPECT_EQ(result->count(), 0U);
    EXPECT_TRUE(recorder.elements.empty());
}

TEST(OrvoMap, WithOnlyNilAnswersIsEmptyAndNotNil) {
    const auto result = OrvoMap(NSArray::arrayWithObjects(texts({"a", "b"})),
                                [](const Object&, std::size_t) { return Object(); });
    ASSERT_TRUE(result);
    EXPECT_EQ(result->count(), 0U);
}

TEST(OrvoMap, GivesEachElementWithItsPlaceInOrder) {
    Recorder recorder;
    const auto result =
        OrvoMap(NSArray::arrayWithObjects(texts({"a", "b", "c"})), recorder.block());
    EXPECT_EQ(recorder.elements, (std::vector<std::string>{"a", "b", "c"}));
    EXPECT_EQ(recorder.indexes, (std::vector<std::size_t>{0, 1, 2}));
    EXPECT_EQ(textsIn(result), recorder.elements);
}

TEST(OrvoMap, KeepsTheAnswersAndNotTheElements) {
    const auto result =
        OrvoMap(NSArray::arrayWithObjects(texts({"a"})), [](const Object&, std::size_t) -> Object {
            return NSNumber::numberWithInteger(7);
        });
    EXPECT_TRUE(equal(result, NSArray::arrayOf({NSNumber::numberWithInteger(7)})));
}

TEST(OrvoMap, IndexesGoOnCountingWhereAnAnswerIsLeftOut) {
    std::vector<std::size_t> indexes;
    const auto result = OrvoMap(NSArray::arrayWithObjects(texts({"a", "b", "c"})),
                                [&](const Object& element, std::size_t index) {
                                    indexes.push_back(index);
                                    return index == 1 ? Object() : element;
                                });
    EXPECT_EQ(indexes, (std::vector<std::size_t>{0, 1, 2}));
    EXPECT_EQ(textsIn(result), (std::vector<std::string>{"a", "c"}));
}

TEST(OrvoMap, TakesAnyCollectionThatCanBeWalked) {
    Recorder ordered;
    (void)OrvoMap(NSOrderedSet::orderedSetWithObjects(texts({"b", "a", "b"})), ordered.block());
    EXPECT_EQ(ordered.elements, (std::vector<std::string>{"b", "a"}));

    const auto set = NSMutableSet::set();
    set->addObject(NSString::string("x"));
    set->addObject(NSString::string("y"));
    Recorder unordered;
    EXPECT_EQ(OrvoMap(set, unordered.block())->count(), 2U);
}

TEST(OrvoMap, AnswersACopyThatTheCollectionNoLongerChanges) {
    const auto set = NSMutableSet::set();
    set->addObject(NSString::string("x"));
    Recorder recorder;
    const auto result = OrvoMap(set, recorder.block());
    set->addObject(NSString::string("y"));
    EXPECT_EQ(textsIn(result), (std::vector<std::string>{"x"}));
}

} // namespace
} // namespace orvo
