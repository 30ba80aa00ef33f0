#include "print/WidgetSnapshot.h"

#include "platform/extension/WidgetCard.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/ViewDrawing.h"
#include "platform/uikit/drawing/PngWriter.h"
#include "print/WidgetScene.h"

#include <cerrno>
#include <cmath>
#include <cstring>
#include <fmt/format.h>
#include <fstream>
#include <vector>

namespace orvo::WidgetSnapshot {

namespace {

/// Why it failed; nothing when it did not.
std::optional<std::string> writeBytes(const std::filesystem::path& file,
                                      const std::vector<std::uint8_t>& bytes) {
    errno = 0;
    std::ofstream stream(file, std::ios::binary | std::ios::trunc);
    if (stream)
        stream.write(reinterpret_cast<const char*>(bytes.data()),
                     static_cast<std::streamsize>(bytes.size()));
    stream.close();
    return stream ? std::nullopt
                  : std::optional<std::string>(std::strerror(errno != 0 ? errno : EIO));
}

/// The same for a file that is at every moment whole.
std::optional<std::string> replace(const std::filesystem::path& file,
                                   const std::vector<std::uint8_t>& bytes) {
    auto aside = file;
    aside += ".new";
    auto failure = writeBytes(aside, bytes);
    std::error_code error;
    if (!failure) {
        std::filesystem::rename(aside, file, error);
        if (error)
            failure = error.message();
    }
    if (failure)
        std::filesystem::remove(aside, error);
    return failure;
}

} // namespace

std::optional<std::string>
write(const WidgetScene& scene, double scale, const std::filesystem::path& file) {
    const auto image = snapshotOf(*scene.card(), scale);
    const auto pixelsOf = [scale](CGFloat points) {
        return static_cast<int>(std::lround(points * scale));
    };
    const auto bytes = PngWriter::write(
        image->pixels(), pixelsOf(image->size().width), pixelsOf(image->size().height), scale);
    // A pipe or a device takes the bytes; there is nothing to put in its place.
    std::error_code unknown;
    const auto status = std::filesystem::status(file, unknown);
    const bool isPlain = !std::filesystem::exists(status) ||
                         std::filesystem::is_regular_file(status) ||
                         std::filesystem::is_directory(status);
    const auto failure = isPlain ? replace(file, bytes) : writeBytes(file, bytes);
    return failure ? std::optional(fmt::format("{}: {}", file.string(), *failure)) : std::nullopt;
}

} // namespace orvo::WidgetSnapshot
