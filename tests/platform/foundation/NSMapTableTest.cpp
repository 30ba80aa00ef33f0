#include "platform/foundation/NSMapTable.h"

#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

namespace orvo {
namespace {

std::shared_ptr<NSString> text(const char* utf8) {
    return NSString::string(utf8);
}
std::shared_ptr<NSMapTable> weakValues() {
    return NSMapTable::mapTableWithOptions({.valueMemory = MapTableOptions::Memory::Weak});
}

TEST(NSMapTable, FindsByContentUnlessToldOtherwise) {
    const auto table = NSMapTable::strongToStrongObjectsMapTable();
    table->setObject_forKey(text("value"), text("key"));
    EXPECT_EQ(descriptionOf(table->objectForKey(text("key"))), "value");
    EXPECT_EQ(table->objectForKey(text("other")), nullptr);
    EXPECT_EQ(table->objectForKey(nullptr), nullptr);
}

TEST(NSMapTable, TellsEqualKeysApartByIdentity) {
    const auto table = NSMapTable::identityMapTable();
    const auto a = text("key");
    const auto b = text("key");
    table->setObject_forKey(text("of a"), a);
    EXPECT_EQ(table->objectForKey(b), nullptr);
    table->setObject_forKey(text("of b"), b);
    EXPECT_EQ(table->count(), 2U);
    EXPECT_EQ(descriptionOf(table->objectForKey(a)), "of a");
    EXPECT_EQ(descriptionOf(table->objectForKey(b)), "of b");
}

TEST(NSMapTable, KeepsPlaceAndKeyOfAnEntryThatGetsAnotherValue) {
    const auto table = NSMapTable::strongToStrongObjectsMapTable();
    const auto first = text("a");
    table->setObject_forKey(text("1"), first);
    table->setObject_forKey(text("2"), text("b"));
    table->setObject_forKey(text("3"), text("a"));
    EXPECT_EQ(table->description(), "NSMapTable { a -> 3; b -> 2; }");
    EXPECT_EQ(table->allKeys()->objectAtIndex(0), first);
}

TEST(NSMapTable, ForgetsAnEntryWhenItsWeakKeyGoes) {
    const auto table = NSMapTable::weakToStrongObjectsMapTable();
    auto key = text("key");
    const auto kept = text("kept");
    table->setObject_forKey(text("1"), key);
    table->setObject_forKey(text("2"), kept);
    EXPECT_EQ(table->count(), 2U);
    key.reset();
    EXPECT_EQ(table->count(), 1U);
    EXPECT_EQ(table->description(), "NSMapTable { kept -> 2; }");
    EXPECT_EQ(table->objectForKey(text("key")), nullptr);
}

TEST(NSMapTable, ComparesWeakKeysByIdentity) {
    const auto table = NSMapTable::weakToStrongObjectsMapTable();
    const auto key = text("key");
    table->setObject_forKey(text("1"), key);
    EXPECT_EQ(table->objectForKey(text("key")), nullptr);
    EXPECT_EQ(descriptionOf(table->objectForKey(key)), "1");
}

TEST(NSMapTable, NeverMistakesANewObjectForADeadKeyAtItsAddress) {
    const auto table = NSMapTable::weakToStrongObjectsMapTable();
    for (int i = 0; i < 1000; ++i) {
        const auto key = text("key");
        ASSERT_EQ(table->objectForKey(key), nullptr);
        table->setObject_forKey(text("value"), key);
    }
    EXPECT_EQ(table->count(), 0U);
}

TEST(NSMapTable, LetsTheValuesOfDeadKeysGoAsItGrows) {
    const auto table = NSMapTable::weakToStrongObjectsMapTable();
    std::vector<std::weak_ptr<NSString>> values;
    for (int i = 0; i < 1000; ++i) {
        const auto value = text("value");
        values.push_back(value);
        table->setObject_forKey(value, text("key"));
    }
    EXPECT_LT(std::ranges::count_if(values, [](const auto& value) { return !value.expired(); }),
              100);
}

TEST(NSMapTable, ForgetsAnEntryWhenItsWeakValueGoes) {
    const auto table = weakValues();
    auto value = text("value");
    table->setObject_forKey(value, text("key"));
    EXPECT_EQ(table->objectForKey(text("key")), value);
    value.reset();
    EXPECT_EQ(table->objectForKey(text("key")), nullptr);
    EXPECT_EQ(table->count(), 0U);
    EXPECT_EQ(table->allKeys()->count(), 0U);
    const auto next = text("next");
    table->setObject_forKey(next, text("key"));
    EXPECT_EQ(table->objectForKey(text("key")), next);
}

TEST(NSMapTable, RemovesOneEntryOrAll) {
    const auto table = NSMapTable::strongToStrongObjectsMapTable();
    for (const char* key : {"a", "b", "c"})
        table->setObject_forKey(text(key), text(key));
    table->removeObjectForKey(text("b").get());
    table->removeObjectForKey(text("z").get());
    table->removeObjectForKey(nullptr);
    EXPECT_EQ(table->description(), "NSMapTable { a -> a; c -> c; }");
    table->removeAllObjects();
    EXPECT_EQ(table->count(), 0U);
}

TEST(NSMapTable, RaisesForNil) {
    const auto table = NSMapTable::strongToStrongObjectsMapTable();
    EXPECT_THROW(table->setObject_forKey(nullptr, text("a")), NSInvalidArgumentException);
    EXPECT_THROW(table->setObject_forKey(text("a"), nullptr), NSInvalidArgumentException);
}

TEST(NSMapTable, EnumeratesKeysInOrderOfFirstSettingWhileItIsChanged) {
    const auto table = NSMapTable::strongToStrongObjectsMapTable();
    for (const char* key : {"c", "a", "b"})
        table->setObject_forKey(text("x"), text(key));
    std::string seen;
    table->enumerate([&](const auto& key) {
        seen += key->description();
        table->removeObjectForKey(key.get());
        return true;
    });
    EXPECT_EQ(seen, "cab");
    EXPECT_EQ(table->count(), 0U);
}

/// Looks at the table once more as it goes.
class Visitor : public virtual NSObject {
public:
    Visitor(NSMapTable& table, std::vector<std::size_t>& counts)
        : _table(table)
        , _counts(counts) {}
    ~Visitor() override { _counts.push_back(_table.count()); }

private:
    NSMapTable& _table;
    std::vector<std::size_t>& _counts;
};

TEST(NSMapTable, IsWholeWhenAValueThatGoesComesBackToIt) {
    std::vector<std::size_t> counts;
    const auto table = NSMapTable::strongToStrongObjectsMapTable();
    table->setObject_forKey(std::make_shared<Visitor>(*table, counts), text("key"));
    table->setObject_forKey(std::make_shared<Visitor>(*table, counts), text("key"));
    table->removeObjectForKey(text("key").get());
    table->setObject_forKey(std::make_shared<Visitor>(*table, counts), text("key"));
    table->removeAllObjects();
    EXPECT_EQ(counts, (std::vector<std::size_t>{1, 0, 0}));
}

TEST(NSMapTable, IsEqualToTheSameEntriesWhateverTheOrderAndHashesAlike) {
    const auto a = NSMapTable::strongToStrongObjectsMapTable();
    const auto b = NSMapTable::strongToStrongObjectsMapTable();
    a->setObject_forKey(text("1"), text("a"));
    a->setObject_forKey(text("2"), text("b"));
    b->setObject_forKey(text("2"), text("b"));
    EXPECT_FALSE(a->isEqual(b.get()));
    EXPECT_FALSE(b->isEqual(a.get()));
    b->setObject_forKey(text("1"), text("a"));
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    b->setObject_forKey(text("3"), text("a"));
    EXPECT_FALSE(a->isEqual(b.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
}

TEST(NSMapTable, IsCopiedWithItsWayOfHolding) {
    const auto table = NSMapTable::weakToStrongObjectsMapTable();
    auto key = text("key");
    table->setObject_forKey(text("1"), key);
    const auto copy = std::dynamic_pointer_cast<NSMapTable>(table->copy());
    ASSERT_NE(copy, nullptr);
    EXPECT_NE(copy, table);
    EXPECT_EQ(descriptionOf(copy->objectForKey(key)), "1");
    table->removeAllObjects();
    EXPECT_EQ(copy->count(), 1U);
    key.reset();
    EXPECT_EQ(copy->count(), 0U);
}

} // namespace
} // namespace orvo
