#include "print/WidgetProgram.h"

#include "fetching/FavoritesContainer_OWFavorites.h"
#include "platform/extension/HeadlessApplication.h"
#include "platform/extension/WidgetHost.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/RunLoop.h"
#include "print/JsonPrinter.h"
#include "print/RowTap.h"
#include "print/TerminationSignals.h"
#include "print/TextPrinter.h"
#include "print/WaybarPrinter.h"
#include "print/WidgetDump.h"
#include "print/WidgetFollower.h"
#include "print/WidgetScene.h"
#include "print/WidgetSnapshot.h"

#include <algorithm>
#include <filesystem>
#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

/// How old what is followed may become before it is asked for again, in seconds.
constexpr NSTimeInterval FollowRefreshInterval = 60;
/// A demonstration that cannot be renewed is not tried again sooner, in seconds.
constexpr NSTimeInterval LeastDemonstration = 60;

} // namespace

WidgetProgram::WidgetProgram(Extension extension,
                             Terminal terminal,
                             std::optional<WidgetWindowing> windowing)
    : _extension(std::move(extension))
    , _terminal(std::move(terminal))
    , _windowing(std::move(windowing)) {}

ExitCode WidgetProgram::run(const std::vector<std::string>& words) {
    const auto parsed = WidgetOptions::parse(
        words, _windowing ? WidgetOptions::Display::Present : WidgetOptions::Display::None);
    if (const auto* error = std::get_if<UsageError>(&parsed)) {
        _terminal.error(error->message, error->cure);
        return ExitCode::WrongUsage;
    }
    const auto& options = std::get<WidgetOptions>(parsed);
    if (options.wantsHelp) {
        _terminal.output() << WidgetOptions::help(_terminal.settings().width);
        return ExitCode::Answered;
    }
    if (options.wantsVersion) {
        _terminal.output() << WidgetOptions::ProgramName << ' ' << ORVO_VERSION << '\n';
        return ExitCode::Answered;
    }
    if (options.showsWindow)
        return showWindow(options);
    // A program that ends with its answer looks for no newer schedules beside it; `orvo` does that.
    _checksSchedules.emplace(ScheduleUpdater::checksDaily().overrideWith(false));
    if (options.completion) {
        _terminal.output() << WidgetOptions::completionScript(*options.completion);
        return ExitCode::Answered;
    }
    if (options.follows)
        return follow(options);
    makeHeadlessApplication();
    if (!applyEnvironment(options))
        return ExitCode::Failed;
    const auto code = options.draws() ? draw(options)
                      : options.open  ? open(options)
                                      : print(options);
    return tellUnreadableFavorites() ? ExitCode::Failed : code;
}

bool WidgetProgram::tellUnreadableFavorites() {
    const auto error = OWFavorites::defaultContainer()->unreadable();
    auto message = error ? error->localizedDescription() : std::string();
    if (!message.empty() && message != _saidOfFavorites)
        _terminal.error(message);
    _saidOfFavorites = std::move(message);
    return error != nullptr;
}

bool WidgetProgram::applyEnvironment(const WidgetOptions& options) {
    if (options.language)
        _language.emplace(Text::locale().overrideWith(*options.language));
    auto traits = options.showsWindow ? UITraitCollection() : options.traits;
    if (Text::isRightToLeft(Text::locale().get()))
        traits.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft;
    _traits.emplace(UITraitCollection::system().overrideWith(traits));
    if (options.at) {
        const auto time = *options.at - NSTimeIntervalSince1970;
        _clock.emplace(Environment::wallClock().overrideWith(options.follows || options.showsWindow
                                                                 ? WallClock::startingAt(time)
                                                                 : WallClock::standingAt(time)));
    }
    // Looking at one's own lines, or at another time, leaves no trace.
    if (options.at || (!options.usesDemonstration && !options.open && !options.showsWindow))
        _keepsWritesInMemory.emplace(Environment::keepsWritesInMemory().overrideWith(true));
    if (options.usesDemonstration) {
        std::shared_ptr<NSError> error;
        _demonstration = DemoVisit::begin(DemoVisit::Purpose::Look, &error);
        if (!_demonstration) {
            _terminal.error(error->localizedDescription());
            return false;
        }
    }
    return true;
}

void WidgetProgram::renewDemonstration() {
    const auto error = _demonstration ? _demonstration->renew() : nullptr;
    auto message = error ? error->localizedDescription() : std::string();
    if (!message.empty() && message != _saidOfDemonstration)
        _terminal.error(message);
    _saidOfDemonstration = std::move(message);
}

void WidgetProgram::keepDemonstration(const std::shared_ptr<WidgetHost>& host) {
    if (!_demonstration)
        return;
    _endOfDemonstration = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
        std::max(_demonstration->secondsLeft(), LeastDemonstration),
        false,
        [this, weak = std::weak_ptr<WidgetHost>(host)](const auto&) {
            const auto shown = weak.lock();
            if (!shown)
                return;
            renewDemonstration();
            // The answer may be to a question from before; the one after it is not.
            shown->requestUpdate([weak](NCUpdateResult) {
                DispatchQueue::mainQueue()->async([weak] {
                    if (const auto answered = weak.lock())
                        answered->requestUpdate();
                });
            });
            keepDemonstration(shown);
        });
}

std::unique_ptr<WidgetPrinter> WidgetProgram::printer(const WidgetOptions& options) const {
    using Layout = JsonWriter::Layout;
    using Payloads = JsonPrinter::Payloads;
    switch (options.form) {
    case WidgetOptions::Form::Json:
        return std::make_unique<JsonPrinter>(options.follows ? Layout::OneLine : Layout::Lines,
                                             options.withPayloads ? Payloads::WithUserInfo
                                                                  : Payloads::LeftOut);
    case WidgetOptions::Form::Waybar:
        return std::make_unique<WaybarPrinter>();
    case WidgetOptions::Form::Text:
        break;
    }
    return std::make_unique<TextPrinter>(_terminal);
}

std::unique_ptr<WidgetScene> WidgetProgram::scene(const WidgetOptions& options) const {
    // A widget that begins compact keeps what it knows, whatever that can show.
    auto scene =
        std::make_unique<WidgetScene>(_extension,
                                      WidgetHostSettings{.width = options.width,
                                                         .maxRows = options.maxRows,
                                                         .mode = NCWidgetDisplayMode::Compact});
    scene->appear();
    return scene;
}

std::unique_ptr<WidgetScene> WidgetProgram::updatedScene(const WidgetOptions& options) const {
    auto scene = this->scene(options);
    _terminal.progress("Asking the feeds …");
    scene->update();
    _terminal.endProgress();
    return scene;
}

ExitCode WidgetProgram::showWindow(const WidgetOptions& options) {
    const TerminationSignals signals([] { RunLoop::main().stop(); });
    _windowing->makeApplication();
    if (!applyEnvironment(options))
        return ExitCode::Failed;
    const auto code = _windowing->run(
        _extension,
        WidgetHostSettings{.width = options.width,
                           .maxRows = options.maxRows,
                           .mode = options.mode,
                           .followsLanguage = !options.language},
        [this](const std::shared_ptr<WidgetHost>& host) { keepDemonstration(host); });
    if (_endOfDemonstration)
        _endOfDemonstration->invalidate();
    return static_cast<ExitCode>(code);
}

ExitCode WidgetProgram::print(const WidgetOptions& options) const {
    const auto scene = updatedScene(options);
    _terminal.output() << printer(options)->text(scene->printed()) << std::flush;
    return options.pictures ? drawPictures(*scene, options) : ExitCode::Answered;
}

ExitCode WidgetProgram::drawPictures(const WidgetScene& scene, const WidgetOptions& options) const {
    const std::filesystem::path folder = *options.pictures;
    std::error_code failed;
    std::filesystem::create_directories(folder, failed);
    if (failed)
        return fail(fmt::format("{}: {}", folder.string(), failed.message()));
    const auto draw = [&](const char* name) {
        const auto file = folder / name;
        auto failure = WidgetSnapshot::write(scene, options.traits.displayScale, file);
        if (!failure)
            _terminal.note("Picture: " + file.string());
        return failure;
    };
    const auto& host = scene.host();
    auto failure = draw("widget-compact.png");
    if (!failure && host->offersExpanded()) {
        host->setDisplayMode(NCWidgetDisplayMode::Expanded);
        failure = draw("widget-expanded.png");
    }
    return failure ? fail(*failure) : ExitCode::Answered;
}

ExitCode WidgetProgram::follow(const WidgetOptions& options) {
    const TerminationSignals signals([] { RunLoop::main().stop(); });
    makeHeadlessApplication();
    if (!applyEnvironment(options))
        return ExitCode::Failed;
    const auto printer = this->printer(options);
    const auto scene = this->scene(options);
    std::string last;
    const WidgetFollower follower(
        *scene,
        FollowRefreshInterval,
        [this] { renewDemonstration(); },
        [&](const PrintedWidget& widget) {
            tellUnreadableFavorites();
            auto text = printer->text(widget);
            if (text == last)
                return;
            last = std::move(text);
            if (!(_terminal.output() << last << std::flush))
                RunLoop::main().stop();
        });
    RunLoop::main().run();
    return ExitCode::Answered;
}

ExitCode WidgetProgram::open(const WidgetOptions& options) const {
    const auto scene = updatedScene(options);
    const auto failure = RowTap::perform(*scene, options.mode, *options.open);
    return failure ? fail(*failure) : ExitCode::Answered;
}

ExitCode WidgetProgram::draw(const WidgetOptions& options) const {
    const auto scene = updatedScene(options);
    const auto& host = scene->host();
    if (options.mode == NCWidgetDisplayMode::Expanded && !host->offersExpanded())
        return fail("there is nothing more to show in expanded mode");
    if (options.mode != NCWidgetDisplayMode::Compact && host->offersExpanded())
        host->setDisplayMode(NCWidgetDisplayMode::Expanded);
    if (options.snapshot) {
        const auto failure =
            WidgetSnapshot::write(*scene, options.traits.displayScale, *options.snapshot);
        return failure ? fail(*failure) : ExitCode::Answered;
    }
    if (options.dump == WidgetOptions::Dump::Archive) {
        scene->disappear();
        _terminal.output() << WidgetDump::archive();
        return ExitCode::Answered;
    }
    _terminal.output() << (options.dump == WidgetOptions::Dump::Views
                               ? WidgetDump::views(*scene)
                               : WidgetDump::constraints(*scene));
    return ExitCode::Answered;
}

ExitCode WidgetProgram::fail(const std::string& reason) const {
    _terminal.error(reason);
    return ExitCode::Failed;
}

} // namespace orvo
