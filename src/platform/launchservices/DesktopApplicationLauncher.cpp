#include "platform/launchservices/DesktopApplicationLauncher.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "platform/launchservices/ApplicationBus.h"
#include "platform/launchservices/ProgramStart.h"

#include <QDBusConnection>
#include <QDBusError>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <fmt/format.h>
#include <unistd.h>

namespace orvo {

namespace {

std::shared_ptr<NSError> launchError(LaunchServicesErrorCode code, std::string message) {
    return NSError::errorWithMessage(
        LaunchServicesErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

void answerLater(ApplicationLauncher::CompletionHandler handler, std::shared_ptr<NSError> error) {
    if (handler)
        DispatchQueue::mainQueue()->async(
            [handler = std::move(handler), error = std::move(error)] { handler(error); });
}

bool usesDemonstration() {
    // Its data may stand in another place for a while; its state does not.
    return Environment::profile().get().state == ProfileFolders::demonstration().state;
}

QVariantMap platformData() {
    QVariantMap data;
    if (const char* token = std::getenv("XDG_ACTIVATION_TOKEN"))
        data.insert(ApplicationBus::ActivationTokenKey, QString::fromUtf8(token));
    if (const char* startup = std::getenv("DESKTOP_STARTUP_ID"))
        data.insert(ApplicationBus::StartupIdentifierKey, QString::fromUtf8(startup));
    if (usesDemonstration())
        data.insert(ApplicationBus::DemonstrationKey, true);
    return data;
}

/// Whether the bus itself, or nobody on it, answered: then the program may still be there. So it is
/// with a service that the bus could not start.
bool isAbsence(const QDBusError& error) {
    if (error.name().startsWith("org.freedesktop.DBus.Error.Spawn."))
        return true;
    switch (error.type()) {
    case QDBusError::ServiceUnknown:
    case QDBusError::NoServer:
    case QDBusError::Disconnected:
    case QDBusError::NoNetwork:
        return true;
    default:
        return false;
    }
}

std::optional<std::filesystem::path> executable(const std::filesystem::path& path) {
    if (access(path.c_str(), X_OK) != 0 || std::filesystem::is_directory(path))
        return std::nullopt;
    return path;
}

std::optional<std::filesystem::path> onSearchPath(const std::string& name) {
    const char* variable = std::getenv("PATH");
    std::string_view rest = variable ? variable : "";
    while (!rest.empty()) {
        const auto end = std::min(rest.find(':'), rest.size());
        if (auto found = executable(std::filesystem::path(rest.substr(0, end)) / name);
            found && end > 0)
            return found;
        rest.remove_prefix(std::min(end + 1, rest.size()));
    }
    return std::nullopt;
}

/// The program is named after the last part of the identifier, in small letters.
std::string programName(const std::string& applicationIdentifier) {
    auto name = applicationIdentifier.substr(applicationIdentifier.rfind('.') + 1);
    std::ranges::transform(name, name.begin(), [](char c) {
        return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    });
    return name;
}

std::optional<std::filesystem::path> findProgram(const std::string& applicationIdentifier) {
    const auto name = programName(applicationIdentifier);
    std::error_code unreadable;
    const auto folder = std::filesystem::read_symlink("/proc/self/exe", unreadable).parent_path();
    if (!unreadable) {
        if (auto beside = executable(folder / name))
            return beside;
        if (auto inBuildTree = executable(folder.parent_path() / name / name))
            return inBuildTree;
    }
    return onSearchPath(name);
}

void start(const std::string& applicationIdentifier,
           const std::vector<std::string>& arguments,
           const std::shared_ptr<NSData>& input,
           ApplicationLauncher::CompletionHandler handler) {
    const auto program = DesktopApplicationLauncher::programLookup().get()(applicationIdentifier);
    if (!program) {
        answerLater(
            std::move(handler),
            launchError(
                LaunchServicesErrorCode::ApplicationNotFound,
                fmt::format(
                    "The application {} is not installed: there is no service of that name on the "
                    "session bus, and no program {}.",
                    applicationIdentifier,
                    programName(applicationIdentifier))));
        return;
    }
    auto words = arguments;
    if (usesDemonstration())
        words.emplace_back("--demo");
    const int failure = startProgram(*program, words, input);
    answerLater(std::move(handler),
                failure == 0 ? nullptr
                             : launchError(LaunchServicesErrorCode::NotStarted,
                                           fmt::format("{} could not be started: {}.",
                                                       program->string(),
                                                       std::strerror(failure))));
}

/// Calls the application's interface; `fallback` is for when nobody is there to answer.
void call(const std::string& applicationIdentifier,
          const char* method,
          const QVariantList& arguments,
          ApplicationLauncher::CompletionHandler handler,
          const std::function<void(ApplicationLauncher::CompletionHandler)>& fallback) {
    auto bus = QDBusConnection::sessionBus();
    if (!bus.isConnected()) {
        fallback(std::move(handler));
        return;
    }
    auto message = QDBusMessage::createMethodCall(
        QString::fromStdString(applicationIdentifier),
        QString::fromStdString(ApplicationBus::pathOfApplication(applicationIdentifier)),
        ApplicationBus::Interface,
        method);
    message.setArguments(arguments);
    auto* watcher = new QDBusPendingCallWatcher(bus.asyncCall(message));
    QObject::connect(
        watcher, &QDBusPendingCallWatcher::finished, [=](QDBusPendingCallWatcher* finished) {
            const QDBusPendingReply<> reply = *finished;
            finished->deleteLater();
            if (!reply.isError()) {
                answerLater(handler, nullptr);
            } else if (isAbsence(reply.error())) {
                fallback(handler);
            } else {
                answerLater(handler,
                            launchError(LaunchServicesErrorCode::Refused,
                                        fmt::format("{} did not take it: {}.",
                                                    applicationIdentifier,
                                                    reply.error().message().toStdString())));
            }
        });
}

} // namespace

EnvironmentSlot<DesktopApplicationLauncher::ProgramLookup>&
DesktopApplicationLauncher::programLookup() {
    static EnvironmentSlot<ProgramLookup> slot([] { return ProgramLookup(findProgram); });
    return slot;
}

void DesktopApplicationLauncher::openURLs(const std::string& applicationIdentifier,
                                          const std::vector<std::string>& urls,
                                          CompletionHandler completionHandler) {
    QStringList list;
    std::vector<std::string> arguments{"open"};
    for (const auto& url : urls) {
        list.append(QString::fromStdString(url));
        arguments.push_back(url);
    }
    call(applicationIdentifier,
         "Open",
         {list, platformData()},
         std::move(completionHandler),
         [=](CompletionHandler handler) {
             start(applicationIdentifier, arguments, nullptr, std::move(handler));
         });
}

void DesktopApplicationLauncher::activateAction(const std::string& applicationIdentifier,
                                                const std::string& action,
                                                const std::shared_ptr<NSData>& parameter,
                                                CompletionHandler completionHandler) {
    QVariantList parameters;
    if (parameter)
        parameters.append(QByteArray(reinterpret_cast<const char*>(parameter->bytes().data()),
                                     static_cast<qsizetype>(parameter->length())));
    call(applicationIdentifier,
         "ActivateAction",
         {QString::fromStdString(action), parameters, platformData()},
         std::move(completionHandler),
         [=](CompletionHandler handler) {
             start(applicationIdentifier, {"receive", action}, parameter, std::move(handler));
         });
}

} // namespace orvo
