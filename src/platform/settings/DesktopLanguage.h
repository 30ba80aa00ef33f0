#pragma once

#include <functional>
#include <memory>
#include <string>

namespace orvo {

/// Follows the language of the machine, as localed tells it on the system bus. It is asked and
/// never started. Silent where there is no bus, and where the program does not speak the machine's
/// language from its start: then somebody has chosen another one for it. While nobody can say what
/// the machine's is, only what is set in `LC_ALL`, `LC_MESSAGES` or `LANGUAGE` counts as chosen.
/// Main thread.
class DesktopLanguage {
public:
    DesktopLanguage();
    DesktopLanguage(const DesktopLanguage&) = delete;
    DesktopLanguage& operator=(const DesktopLanguage&) = delete;
    ~DesktopLanguage();

    /// Connects, and asks without waiting for the answer. `changed` is called with a BCP-47 tag
    /// whenever the machine's language has become another one; never inside this call. It is for
    /// whoever hears it to set `Text::locale()`.
    void start(std::function<void(const std::string& language)> changed);
    void stop();

private:
    struct Private;

    std::unique_ptr<Private> _private;
};

} // namespace orvo
