#include "print/RowTap.h"

#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationLauncher.h"
#include "print/WidgetScene.h"
#include "widget/OWTransitIncidentsViewController.h"

#include <fmt/format.h>

namespace orvo::RowTap {

namespace {

std::string noSuchRow(std::uint64_t row, NCWidgetDisplayMode mode, std::int64_t count) {
    const char* name = mode == NCWidgetDisplayMode::Compact ? "compact" : "expanded";
    if (count == 0)
        return fmt::format("there are no rows in {} mode", name);
    return fmt::format("there is no row {} in {} mode: the last is {}", row, name, count - 1);
}

/// The launcher in use, and what became of the thing that it was given: the widget itself says only
/// whether that went well, and to nobody outside.
class ObservedLauncher final : public ApplicationLauncher {
public:
    explicit ObservedLauncher(std::shared_ptr<ApplicationLauncher> launcher)
        : _launcher(std::move(launcher)) {}

    void openURLs(const std::string& application,
                  const std::vector<std::string>& urls,
                  CompletionHandler handler) override {
        wasAsked = true;
        _launcher->openURLs(application, urls, observed(std::move(handler)));
    }
    void activateAction(const std::string& application,
                        const std::string& action,
                        const std::shared_ptr<NSData>& parameter,
                        CompletionHandler handler) override {
        wasAsked = true;
        _launcher->activateAction(application, action, parameter, observed(std::move(handler)));
    }

    bool wasAsked = false;
    bool hasAnswered = false;
    std::shared_ptr<NSError> error;

private:
    [[nodiscard]] CompletionHandler observed(CompletionHandler handler) {
        return [self = strong(this),
                handler = std::move(handler)](const std::shared_ptr<NSError>& failure) {
            if (handler)
                handler(failure);
            self->error = failure;
            self->hasAnswered = true;
        };
    }

    std::shared_ptr<ApplicationLauncher> _launcher;
};

/// Nothing, or why the map application did not take it.
std::optional<std::string> outcomeOf(const ObservedLauncher& launcher) {
    // What cannot be handed over fails without anybody being asked.
    if (!launcher.wasAsked)
        return "what the row opens cannot be handed over to the map application";
    if (!RunLoop::main().runUntil([&] { return launcher.hasAnswered; }, Patience))
        return fmt::format("the map application did not answer within {} seconds", Patience);
    return launcher.error ? std::optional(launcher.error->localizedDescription()) : std::nullopt;
}

} // namespace

std::optional<std::string>
perform(WidgetScene& scene, std::optional<NCWidgetDisplayMode> mode, std::uint64_t row) {
    const auto& host = scene.host();
    if (!mode)
        mode =
            host->offersExpanded() ? NCWidgetDisplayMode::Expanded : NCWidgetDisplayMode::Compact;
    host->setDisplayMode(*mode);
    const auto& table = scene.controller()->tableView();
    const auto count = host->displayMode() == *mode ? table->numberOfRowsInSection(0) : 0;
    if (row >= static_cast<std::uint64_t>(count))
        return noSuchRow(row, *mode, count);
    const auto path = NSIndexPath::indexPathForRow_inSection(static_cast<std::int64_t>(row), 0);
    if (!scene.controller()->dataSource()->_openableItemAtIndexPath(path))
        return fmt::format("row {} opens nothing", row);

    const auto launcher = std::make_shared<ObservedLauncher>(ApplicationLauncher::sharedLauncher());
    const auto observing = ApplicationLauncher::launcher().overrideWith(launcher);
    table->_pressRowAtIndexPath(path);
    return outcomeOf(*launcher);
}

} // namespace orvo::RowTap
