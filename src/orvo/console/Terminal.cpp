#include "orvo/console/Terminal.h"

#include "orvo/console/DisplayText.h"

#include <algorithm>
#include <cstdlib>
#include <iostream>
#include <sys/ioctl.h>
#include <unistd.h>

namespace orvo {

namespace {

constexpr std::size_t NarrowestWidth = 20;
constexpr std::size_t PipeWidth = 80;

std::string_view environment(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : std::string_view();
}

std::size_t terminalWidth() {
    winsize size{};
    if (ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0)
        return size.ws_col;
    const long columns = std::strtol(std::string(environment("COLUMNS")).c_str(), nullptr, 10);
    return columns > 0 ? static_cast<std::size_t>(columns) : PipeWidth;
}

const char* escapeFor(Terminal::Style style) {
    switch (style) {
    case Terminal::Style::Bold:
        return "\x1b[1m";
    case Terminal::Style::Faint:
        return "\x1b[2m";
    case Terminal::Style::Good:
        return "\x1b[32m";
    case Terminal::Style::Advisory:
        return "\x1b[33m";
    case Terminal::Style::Plain:
        break;
    }
    return "";
}

} // namespace

Terminal::Terminal(std::ostream& output, std::ostream& error, Settings settings)
    : _output(&output)
    , _error(&error)
    , _settings(std::move(settings)) {
    _settings.width = std::max(_settings.width, NarrowestWidth);
}

Terminal Terminal::standard(std::string program) {
    const bool outputIsTerminal = isatty(STDOUT_FILENO) == 1;
    const bool dumb = environment("TERM").empty() || environment("TERM") == "dumb";
    return {std::cout,
            std::cerr,
            {outputIsTerminal,
             isatty(STDERR_FILENO) == 1,
             outputIsTerminal && !dumb && environment("NO_COLOR").empty(),
             terminalWidth(),
             std::move(program)}};
}

std::string Terminal::styled(std::string_view text, Style style) const {
    if (!_settings.usesStyles || style == Style::Plain || text.empty())
        return std::string(text);
    return std::string(escapeFor(style)).append(text).append("\x1b[0m");
}

void Terminal::error(std::string_view message, std::string_view cure) const {
    endProgress();
    *_error << _settings.program << ": " << message << '\n';
    if (!cure.empty())
        *_error << cure << '\n';
    _error->flush();
}

void Terminal::warning(std::string_view message, std::string_view cure) const {
    error(std::string("warning: ").append(message), cure);
}

void Terminal::note(std::string_view message) const {
    endProgress();
    *_error << message << '\n';
    _error->flush();
}

void Terminal::progress(std::string_view message) const {
    if (!_settings.errorIsTerminal)
        return;
    *_error << "\r\x1b[K" << DisplayText::cut(message, _settings.width - 1);
    _error->flush();
    _showsProgress = true;
}

void Terminal::endProgress() const {
    if (!_showsProgress)
        return;
    *_error << "\r\x1b[K";
    _error->flush();
    _showsProgress = false;
}

} // namespace orvo
