#include "platform/foundation/NSObject.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class Animal : public virtual NSObject {
public:
    Method methodForSelector(const Selector& selector) override {
        if (selector == Selector("speak"))
            return [this](const auto& sender) -> std::shared_ptr<NSObject> {
                lastSender = sender;
                return NSString::string("moo");
            };
        return NSObject::methodForSelector(selector);
    }
    std::shared_ptr<NSObject> lastSender;
};

TEST(NSObject, IsEqualOnlyToItselfUnlessAClassSaysOtherwise) {
    const auto a = std::make_shared<Animal>();
    const auto b = std::make_shared<Animal>();
    EXPECT_TRUE(a->isEqual(a.get()));
    EXPECT_FALSE(a->isEqual(b.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
}

TEST(NSObject, TwoNilsAreEqualAndNilNeverEqualsAValue) {
    const std::shared_ptr<NSString> nil;
    const auto text = NSString::string("");
    EXPECT_TRUE(equal(nil, nil));
    EXPECT_FALSE(equal(nil, text));
    EXPECT_FALSE(equal(text, nil));
    EXPECT_EQ(hashOf(nil), 0U);
    EXPECT_EQ(descriptionOf(nil), "(null)");
}

TEST(NSObject, RootDescriptionNamesTheOwnClassAndTheAddress) {
    const auto animal = std::make_shared<Animal>();
    EXPECT_EQ(animal->className(), "Animal");
    EXPECT_EQ(animal->description().substr(0, 11), "<Animal: 0x");
    EXPECT_EQ(animal->description().back(), '>');
}

TEST(NSObject, PerformsAMethodByNameWithItsSender) {
    const auto animal = std::make_shared<Animal>();
    const auto sender = NSString::string("farmer");
    EXPECT_TRUE(animal->respondsToSelector(Selector("speak")));
    EXPECT_TRUE(equal(animal->performSelector_withObject(Selector("speak"), sender),
                      NSString::string("moo")));
    EXPECT_EQ(animal->lastSender, sender);
    EXPECT_TRUE(animal->performSelector(Selector("speak")));
    EXPECT_EQ(animal->lastSender, nullptr);
}

TEST(NSObject, RaisesForAMethodItDoesNotHave) {
    const auto animal = std::make_shared<Animal>();
    EXPECT_FALSE(animal->respondsToSelector(Selector("fly")));
    EXPECT_THROW((void)animal->performSelector(Selector("fly")), NSInvalidArgumentException);
}

TEST(NSObject, AssociatedObjectsAreHeldUntilDetached) {
    static const char key = 0;
    const auto animal = std::make_shared<Animal>();
    auto value = std::make_shared<Animal>();
    const std::weak_ptr<Animal> watch = value;
    animal->setAssociatedObject(&key, value, AssociationPolicy::RetainNonatomic);
    value.reset();
    EXPECT_FALSE(watch.expired());
    EXPECT_EQ(animal->associatedObject(&key), watch.lock());
    animal->setAssociatedObject(&key, nullptr, AssociationPolicy::RetainNonatomic);
    EXPECT_TRUE(watch.expired());
    EXPECT_EQ(animal->associatedObject(&key), nullptr);
}

TEST(NSObject, AssociatedObjectsGoWithTheirOwner) {
    static const char key = 0;
    auto animal = std::make_shared<Animal>();
    auto value = std::make_shared<Animal>();
    const std::weak_ptr<Animal> watch = value;
    animal->setAssociatedObject(&key, std::move(value), AssociationPolicy::CopyNonatomic);
    animal.reset();
    EXPECT_TRUE(watch.expired());
}

} // namespace
} // namespace orvo
