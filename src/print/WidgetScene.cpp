#include "print/WidgetScene.h"

#include "platform/extension/WidgetCard.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/RunLoop.h"
#include "widget/OWTransitIncidentsViewController.h"

#include <limits>

namespace orvo {

WidgetScene::WidgetScene(const Extension& extension, const WidgetHostSettings& settings)
    : _host(WidgetHost::hostWithExtension_settings(extension, settings))
    , _controller(
          std::dynamic_pointer_cast<OWTransitIncidentsViewController>(_host->controller())) {
    if (!_controller)
        throw NSInvalidArgumentException("only the transit widget can be printed");
}

WidgetScene::~WidgetScene() {
    disappear();
}

void WidgetScene::appear() {
    _host->setShown(true);
}

void WidgetScene::update() {
    const auto hasEnded = std::make_shared<bool>(false);
    _host->requestUpdate([hasEnded](NCUpdateResult) { *hasEnded = true; });
    auto& loop = RunLoop::main();
    loop.runUntil([&] { return *hasEnded; }, std::numeric_limits<double>::infinity());
    loop.runOnce(); // the mode is settled a turn later
}

void WidgetScene::disappear() {
    _host->setShown(false);
}

PrintedWidget WidgetScene::printed() const {
    const auto& dataSource = _controller->dataSource();
    return PrintedWidget::of(*dataSource->listItem(), dataSource->transitLineItemResult());
}

std::shared_ptr<WidgetCard> WidgetScene::card() const {
    const auto card = WidgetCard::cardWithHost_offersButton(_host, false);
    const CGSize content{_host->contentSize().width, _host->preferredHeight()};
    card->setFrame({{0, 0}, WidgetCard::sizeForContentSize(content)});
    card->layoutIfNeeded();
    return card;
}

} // namespace orvo
