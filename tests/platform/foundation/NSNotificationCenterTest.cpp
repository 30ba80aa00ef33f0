#include "platform/foundation/NSNotificationCenter.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <utility>
#include <vector>

namespace orvo::NSNotificationCenterTests {
namespace {

class Observer final : public virtual NSObject {
public:
    explicit Observer(std::function<void(const NSNotification&)> heard)
        : _heard(std::move(heard)) {}
    Method methodForSelector(const Selector& selector) override {
        if (selector == Selector("heard:"))
            return [this](const auto& sender) -> std::shared_ptr<NSObject> {
                _heard(dynamic_cast<const NSNotification&>(*sender));
                return nullptr;
            };
        return NSObject::methodForSelector(selector);
    }

private:
    std::function<void(const NSNotification&)> _heard;
};

class NSNotificationCenterTest : public ::testing::Test {
protected:
    std::shared_ptr<Observer> observer(const std::string& mark) {
        return std::make_shared<Observer>(
            [this, mark](const NSNotification& one) { heard.push_back(mark + one.name()); });
    }
    void add(const std::shared_ptr<NSObject>& observer,
             std::optional<std::string> name = "Changed",
             const std::shared_ptr<NSObject>& object = nullptr) {
        center->addObserver_selector_name_object(
            observer, Selector("heard:"), std::move(name), object);
    }
    using Heard = std::vector<std::string>;

    std::shared_ptr<NSNotificationCenter> center = std::make_shared<NSNotificationCenter>();
    Heard heard;
};

TEST_F(NSNotificationCenterTest, TellsObserversOfTheNameInTheOrderOfTheirAdding) {
    const auto a = observer("a");
    const auto b = observer("b");
    add(a);
    add(b);
    center->postNotificationName_object("Changed", nullptr);
    center->postNotificationName_object("Other", nullptr);
    EXPECT_EQ(heard, (Heard{"aChanged", "bChanged"}));
}

TEST_F(NSNotificationCenterTest, WithoutANameAllNamesAreHeard) {
    const auto a = observer("a");
    add(a, std::nullopt);
    center->postNotificationName_object("Other", nullptr);
    EXPECT_EQ(heard, Heard{"aOther"});
}

TEST_F(NSNotificationCenterTest, OnlyTheGivenObjectsNotificationsAreHeard) {
    const auto a = observer("a");
    const auto object = NSString::string("x");
    add(a, "Changed", object);
    center->postNotificationName_object("Changed", NSString::string("x"));
    EXPECT_EQ(heard, Heard{});
    center->postNotificationName_object("Changed", object);
    EXPECT_EQ(heard, Heard{"aChanged"});
}

TEST_F(NSNotificationCenterTest, AddedTwiceIsToldTwiceAndRemovedAtOnceFromAllNames) {
    const auto a = observer("a");
    add(a);
    add(a);
    add(a, "Other");
    center->postNotificationName_object("Changed", nullptr);
    EXPECT_EQ(heard.size(), 2U);
    center->removeObserver(*a);
    EXPECT_EQ(center->_observerCount(), 0U);
    center->postNotificationName_object("Changed", nullptr);
    center->postNotificationName_object("Other", nullptr);
    EXPECT_EQ(heard.size(), 2U);
}

TEST_F(NSNotificationCenterTest, HoldsObserversWeakly) {
    auto a = observer("a");
    const std::weak_ptr<NSObject> weak = a;
    add(a);
    a.reset();
    EXPECT_TRUE(weak.expired());
    EXPECT_EQ(center->_observerCount(), 0U);
    center->postNotificationName_object("Changed", nullptr);
    EXPECT_EQ(heard, Heard{});
}

TEST_F(NSNotificationCenterTest, WhoIsRemovedWhileOthersAreToldIsNotTold) {
    const auto b = observer("b");
    const auto a =
        std::make_shared<Observer>([&](const NSNotification&) { center->removeObserver(*b); });
    add(a);
    add(b);
    center->postNotificationName_object("Changed", nullptr);
    EXPECT_EQ(heard, Heard{});
}

TEST_F(NSNotificationCenterTest, WhoIsAddedWhileOthersAreToldHearsTheNextOne) {
    const auto b = observer("b");
    const auto a = std::make_shared<Observer>([&](const NSNotification&) {
        if (center->_observerCount() == 1)
            add(b);
    });
    add(a);
    center->postNotificationName_object("Changed", nullptr);
    EXPECT_EQ(heard, Heard{});
    center->postNotificationName_object("Changed", nullptr);
    EXPECT_EQ(heard, Heard{"bChanged"});
}

TEST_F(NSNotificationCenterTest, AnObserverWithoutTheMethodIsAProgrammingError) {
    EXPECT_THROW(add(nullptr), NSInvalidArgumentException);
    EXPECT_THROW(add(NSString::string("x")), NSInvalidArgumentException);
}

TEST_F(NSNotificationCenterTest, TheDefaultCenterIsOneObject) {
    EXPECT_EQ(NSNotificationCenter::defaultCenter(), NSNotificationCenter::defaultCenter());
}

} // namespace
} // namespace orvo::NSNotificationCenterTests
