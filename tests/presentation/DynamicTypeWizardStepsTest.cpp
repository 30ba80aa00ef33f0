#include "platform/foundation/NSNumber.h"
#include "presentation/DynamicTypeWizard.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

namespace orvo {
namespace {

using ::testing::ElementsAre;

/// Responds to `doIt`.
class Doing final : public virtual NSObject {
public:
    Method methodForSelector(const Selector& selector) override {
        if (selector.name() != "doIt")
            return NSObject::methodForSelector(selector);
        return [](const auto&) {
            return nullptr;
        };
    }
};

/// Notes its phase when it goes.
class Leaving final : public virtual NSObject {
public:
    Leaving(std::uint64_t phase, std::vector<std::uint64_t>& left)
        : _phase(phase)
        , _left(left) {}
    ~Leaving() override { _left.push_back(_phase); }

private:
    std::uint64_t _phase;
    std::vector<std::uint64_t>& _left;
};

TEST(DynamicTypeWizardSteps, AnObjectLeavesThePhasesZeroTwoAndOne) {
    const auto object = std::make_shared<Doing>();
    std::vector<std::uint64_t> left;
    const auto& maps = DynamicTypeWizard::_singletonInstance()->objectToSelectorStringMaps();
    for (const std::uint64_t phase : {0U, 1U, 2U}) {
        DynamicTypeWizard::makeObject_performSelector_whenSizeCategoryChangesWithOrder(
            object, Selector("doIt"), phase);
        const auto map = std::dynamic_pointer_cast<NSMapTable>(
            maps->objectForKey(*NSNumber::numberWithUnsignedInteger(phase)));
        ASSERT_TRUE(map->objectForKey(object));
        map->setObject_forKey(std::make_shared<Leaving>(phase, left), object);
    }
    DynamicTypeWizard::unregisterObject(object);
    EXPECT_THAT(left, ElementsAre(0U, 2U, 1U));
}

} // namespace
} // namespace orvo
