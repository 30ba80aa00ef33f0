#include "platform/foundation/KeyIndex.h"

#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

/// Equal to objects of the same name, and all of one hash.
class Colliding : public virtual NSObject {
public:
    explicit Colliding(int name)
        : _name(name) {}
    bool isEqual(const NSObject* other) const override {
        const auto* colliding = dynamic_cast<const Colliding*>(other);
        return colliding && colliding->_name == _name;
    }
    std::uint64_t hash() const override { return 42; }

private:
    int _name;
};

TEST(KeyIndex, FindsByContent) {
    KeyIndex index;
    const auto key = NSString::string("a");
    index.insert(*key, 7);
    EXPECT_EQ(index.find(*NSString::string("a")), 7U);
    EXPECT_EQ(index.find(*NSString::string("b")), std::nullopt);
}

TEST(KeyIndex, FindsByIdentityWhereAsked) {
    KeyIndex index(KeyIndex::Personality::Identity);
    const auto key = NSString::string("a");
    const auto other = NSString::string("a");
    index.insert(*key, 7);
    EXPECT_EQ(index.find(*key), 7U);
    EXPECT_EQ(index.find(*other), std::nullopt);
    index.insert(*other, 8);
    EXPECT_EQ(index.find(*key), 7U);
    EXPECT_EQ(index.find(*other), 8U);
}

TEST(KeyIndex, TellsKeysOfOneHashApart) {
    KeyIndex index;
    const Colliding one(1);
    const Colliding two(2);
    index.insert(one, 1);
    index.insert(two, 2);
    EXPECT_EQ(index.find(Colliding(1)), 1U);
    EXPECT_EQ(index.find(Colliding(2)), 2U);
    EXPECT_EQ(index.find(Colliding(3)), std::nullopt);
    index.erase(Colliding(1));
    EXPECT_EQ(index.find(one), std::nullopt);
    EXPECT_EQ(index.find(two), 2U);
}

TEST(KeyIndex, ErasesOneOrAll) {
    KeyIndex index;
    const auto a = NSString::string("a");
    const auto b = NSString::string("b");
    index.insert(*a, 1);
    index.insert(*b, 2);
    index.erase(*NSString::string("c"));
    index.erase(*NSString::string("a"));
    EXPECT_EQ(index.find(*a), std::nullopt);
    EXPECT_EQ(index.find(*b), 2U);
    index.clear();
    EXPECT_EQ(index.find(*b), std::nullopt);
}

} // namespace
} // namespace orvo
