#include "platform/launchservices/ApplicationService.h"

#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationBus.h"
#include "platform/launchservices/ApplicationLauncher.h"
#include "platform/launchservices/private/BusEndListener.h"

#include <QDBusConnection>
#include <QDBusConnectionInterface>
#include <QDBusError>
#include <QDBusMessage>
#include <QDBusVirtualObject>

#include <fmt/format.h>
#include <optional>

namespace orvo {

namespace {

constexpr const char* Introspection = R"(  <interface name="org.freedesktop.Application">
    <method name="Activate">
      <arg type="a{sv}" name="platform_data" direction="in"/>
    </method>
    <method name="Open">
      <arg type="as" name="uris" direction="in"/>
      <arg type="a{sv}" name="platform_data" direction="in"/>
    </method>
    <method name="ActivateAction">
      <arg type="s" name="action_name" direction="in"/>
      <arg type="av" name="parameter" direction="in"/>
      <arg type="a{sv}" name="platform_data" direction="in"/>
    </method>
  </interface>
)";

ApplicationRequest requestOf(const QVariant& platformData) {
    const auto data = qdbus_cast<QVariantMap>(platformData);
    auto token = data.value(ApplicationBus::ActivationTokenKey).toString();
    if (token.isEmpty())
        token = data.value(ApplicationBus::StartupIdentifierKey).toString();
    return {.usesDemonstration = data.value(ApplicationBus::DemonstrationKey).toBool(),
            .activationToken = token.toStdString()};
}

std::shared_ptr<NSData> dataOf(const QByteArray& bytes) {
    return NSData::dataWithString({bytes.constData(), static_cast<std::size_t>(bytes.size())});
}

class ApplicationObject final : public QDBusVirtualObject {
public:
    explicit ApplicationObject(ApplicationRequestHandler& handler)
        : _handler(handler) {}

    [[nodiscard]] QString introspect(const QString&) const override { return Introspection; }

    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override {
        if (message.interface() != ApplicationBus::Interface && !message.interface().isEmpty())
            return false;
        const auto answer = answerTo(message);
        if (message.isReplyRequired())
            connection.send(answer);
        return true;
    }

private:
    QDBusMessage answerTo(const QDBusMessage& message) {
        const auto given = message.arguments();
        const auto signature = message.signature();
        if (message.member() == "Activate")
            return signature == "a{sv}" ? reply(message, _handler.activate(requestOf(given[0])))
                                        : wrongArguments(message);
        if (message.member() == "Open")
            return signature == "asa{sv}" ? answerToOpen(message, given) : wrongArguments(message);
        if (message.member() == "ActivateAction")
            return signature == "sava{sv}" ? answerToAction(message, given)
                                           : wrongArguments(message);
        return message.createErrorReply(QDBusError::UnknownMethod,
                                        "There is no method " + message.member() + ".");
    }

    QDBusMessage answerToOpen(const QDBusMessage& message, const QVariantList& given) {
        std::vector<std::string> urls;
        for (const auto& url : given[0].toStringList())
            urls.push_back(url.toStdString());
        return reply(message, _handler.openURLs(urls, requestOf(given[1])));
    }

    QDBusMessage answerToAction(const QDBusMessage& message, const QVariantList& given) {
        const auto parameters = qdbus_cast<QVariantList>(given[1]);
        std::shared_ptr<NSData> parameter;
        if (!parameters.isEmpty()) {
            if (parameters.size() > 1 || parameters[0].typeId() != QMetaType::QByteArray)
                return message.createErrorReply(QDBusError::InvalidArgs,
                                                "The parameter of an action is bytes.");
            parameter = dataOf(parameters[0].toByteArray());
        }
        return reply(message,
                     _handler.activateAction(
                         given[0].toString().toStdString(), parameter, requestOf(given[2])));
    }

    static QDBusMessage wrongArguments(const QDBusMessage& message) {
        return message.createErrorReply(QDBusError::InvalidArgs,
                                        message.member() + " takes other arguments than " +
                                            message.signature() + ".");
    }

    static QDBusMessage reply(const QDBusMessage& message, const std::shared_ptr<NSError>& error) {
        return error
                   ? message.createErrorReply(QDBusError::Failed,
                                              QString::fromStdString(error->localizedDescription()))
                   : message.createReply();
    }

    ApplicationRequestHandler& _handler;
};

void setError(std::shared_ptr<NSError>* error, LaunchServicesErrorCode code, std::string message) {
    if (error)
        *error = NSError::errorWithMessage(
            LaunchServicesErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

} // namespace

struct ApplicationService::Private {
    Private(const std::string& applicationIdentifier, ApplicationRequestHandler& handler)
        : name(QString::fromStdString(applicationIdentifier))
        , path(QString::fromStdString(ApplicationBus::pathOfApplication(applicationIdentifier)))
        , object(handler) {}

    QString name;
    QString path;
    ApplicationObject object;
    std::optional<BusEndListener> busEnd;
};

std::unique_ptr<ApplicationService>
ApplicationService::start(const std::string& applicationIdentifier,
                          ApplicationRequestHandler& handler,
                          std::shared_ptr<NSError>* error) {
    // Requests come through the main run loop, which must be there before the connection is.
    (void)RunLoop::main();
    auto bus = QDBusConnection::sessionBus();
    if (!bus.isConnected()) {
        setError(error, LaunchServicesErrorCode::NoBus, "There is no session bus to serve on.");
        return nullptr;
    }
    auto fields = std::make_unique<Private>(applicationIdentifier, handler);
    // The object first: who has seen the name may ask at once.
    if (!bus.registerVirtualObject(fields->path, &fields->object)) {
        setError(error,
                 LaunchServicesErrorCode::AlreadyRuns,
                 fmt::format("{} is served by this process already.", applicationIdentifier));
        return nullptr;
    }
    if (!bus.registerService(fields->name)) {
        bus.unregisterObject(fields->path);
        setError(error,
                 LaunchServicesErrorCode::AlreadyRuns,
                 fmt::format("{} runs already on this session bus.", applicationIdentifier));
        return nullptr;
    }
    fields->busEnd.emplace(bus, [&handler] { handler.busIsGone(); });
    return std::unique_ptr<ApplicationService>(new ApplicationService(std::move(fields)));
}

bool ApplicationService::isRunning(const std::string& applicationIdentifier) {
    const auto bus = QDBusConnection::sessionBus();
    return bus.isConnected() &&
           bus.interface()->isServiceRegistered(QString::fromStdString(applicationIdentifier));
}

ApplicationService::ApplicationService(std::unique_ptr<Private> fields)
    : _private(std::move(fields)) {}

ApplicationService::~ApplicationService() {
    auto bus = QDBusConnection::sessionBus();
    bus.unregisterService(_private->name);
    RunLoop::main().runOnce();
    bus.unregisterObject(_private->path);
}

} // namespace orvo
