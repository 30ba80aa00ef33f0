#include "platform/foundation/Log.h"

#include "platform/foundation/LogFormat.h"
#include "platform/foundation/LogSettings.h"
#include "platform/foundation/LogWriter.h"

#include <map>
#include <mutex>

namespace orvo {

namespace {

// A cached level and the generation of the levels that it is from, in one word.
constexpr unsigned LevelBits = 8;
constexpr std::uint64_t LevelMask = (1U << LevelBits) - 1;

struct Registry {
    std::mutex mutex;
    std::map<std::pair<std::string, std::string>, std::shared_ptr<Log>> logs;
};

Registry& registry() {
    static auto& registry = *new Registry;
    return registry;
}

std::vector<std::pair<std::string, LogLevel>> levelsOfProcess() {
    const auto& settings = LogSettings::ofProcess();
    for (const auto& problem : settings.problems)
        LogWriter::standard()(
            {LogLevel::Error, Log::DefaultSubsystem, "Log", problem, problem, problem});
    return settings.levels;
}

} // namespace

std::shared_ptr<Log> Log::findOrCreate(const std::string& category, const std::string& subsystem) {
    auto& known = registry();
    const std::lock_guard lock(known.mutex);
    auto& log = known.logs[{subsystem, category}];
    if (!log)
        log = std::make_shared<Log>(subsystem, category);
    return log;
}

EnvironmentSlot<LogSink>& Log::sink() {
    static auto& slot = *new EnvironmentSlot<LogSink>(LogWriter::standard);
    return slot;
}

EnvironmentSlot<std::vector<std::pair<std::string, LogLevel>>>& Log::levels() {
    static auto& slot =
        *new EnvironmentSlot<std::vector<std::pair<std::string, LogLevel>>>(levelsOfProcess);
    return slot;
}

Log::Log(std::string subsystem, std::string category)
    : _subsystem(std::move(subsystem))
    , _category(std::move(category)) {}

bool Log::isEnabled(LogLevel level) const {
    const auto generation = levels().generation();
    auto cached = _leastLevel.load(std::memory_order_relaxed);
    if (cached >> LevelBits != generation) {
        const auto least = LogSettings::least(levels().get(), _category);
        cached = generation << LevelBits | static_cast<std::uint64_t>(least);
        _leastLevel.store(cached, std::memory_order_relaxed);
    }
    return static_cast<std::uint64_t>(level) >= (cached & LevelMask);
}

void Log::emit(LogLevel level,
               std::string_view format,
               std::span<const LogArgument> arguments) const {
    auto text = formatLog(format, arguments);
    Log::sink().get()({level,
                       _subsystem,
                       _category,
                       std::string(format),
                       std::move(text.message),
                       std::move(text.redacted)});
}

} // namespace orvo
