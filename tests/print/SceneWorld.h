#pragma once

#include "fetching/FetchingFakes.h"
#include "platform/favorites/FavoritesStore.h"
#include "print/PrintWorld.h"
#include "print/WidgetScene.h"
#include "support/FixedTextMeasurer.h"
#include "support/GraphicalApplication.h"
#include "support/TemporaryProfile.h"
#include "widget/OWTransitIncidentsViewController.h"

#include <stdexcept>

namespace orvo::testing {

/// A profile with a favourite line, a lookup that answers what a test says, and the program's own
/// widget, for the scope of a test.
class SceneWorld {
public:
    SceneWorld() {
        const auto store = FavoritesStore::open(
            FavoritesStore::standardPath(), FavoritesStore::Access::Write, nullptr);
        if (!store || store->addLine(*makeLine(1)))
            throw std::runtime_error("cannot add a favourite");
    }

    static Extension extension() {
        return {{.bundleIdentifier = "a.widget",
                 .containingApplication = "a.map",
                 .displayName = "Transit",
                 .principalClass = "OWTransitIncidentsViewController",
                 .iconName = "WidgetGenericTransit"},
                [] {
                    return OWTransitIncidentsViewController::initWithNibName_bundle(std::nullopt,
                                                                                    nullptr);
                }};
    }
    void answerWith(const std::vector<std::shared_ptr<TransitLineItem>>& lines) const {
        lookup->answerWith({NSArray::arrayOf(lines), nullptr});
    }
    void fail() const {
        lookup->answerWith({nullptr, NSError::errorWithMessage("Test", 1, "no lookup today")});
    }
    /// Compact, with what a fetch has brought: the answers given before.
    static std::unique_ptr<WidgetScene> updatedScene() {
        auto scene = std::make_unique<WidgetScene>(
            extension(), WidgetHostSettings{.mode = NCWidgetDisplayMode::Compact});
        scene->appear();
        scene->update();
        return scene;
    }
    /// Two lines with an advisory each, and one without.
    static std::vector<std::shared_ptr<TransitLineItem>> threeLines() {
        return {line(1, "U1", {incident(11, "Works")}),
                line(2, "U2", {incident(12, "Delays")}),
                line(3, "U3", {})};
    }

    bool graphical = haveGraphicalApplication();
    TemporaryProfile profile;
    PrintWorld world;
    std::shared_ptr<FakeLookup> lookup = std::make_shared<FakeLookup>();

private:
    EnvironmentSlot<std::shared_ptr<LookupService>>::Override _lookupOverride =
        LookupService::shared().overrideWith(lookup);
    EnvironmentSlot<std::shared_ptr<TextMeasurer>>::Override _measurer =
        TextMeasurer::shared().overrideWith(std::make_shared<FixedTextMeasurer>());
};

} // namespace orvo::testing
