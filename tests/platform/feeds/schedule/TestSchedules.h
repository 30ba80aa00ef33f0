#pragma once

#include "platform/feeds/schedule/ScheduleReader.h"
#include "platform/feeds/schedule/ScheduleStream.h"
#include "platform/foundation/NSData.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>
#include <zip.h>

namespace orvo::testing {

/// Files by name, in the order in which they are put into an archive.
using Files = std::vector<std::pair<std::string, std::string>>;

/// The bytes of a zip file with these files; a name that ends with `/` is a folder.
inline std::shared_ptr<NSData> zipOf(const Files& files) {
    zip_error_t error;
    zip_error_init(&error);
    zip_source_t* output = zip_source_buffer_create(nullptr, 0, 0, &error);
    zip_source_keep(output);
    zip_t* zip = zip_open_from_source(output, ZIP_TRUNCATE, &error);
    for (const auto& [name, text] : files) {
        if (name.ends_with('/')) {
            zip_dir_add(zip, name.c_str(), ZIP_FL_ENC_UTF_8);
            continue;
        }
        zip_source_t* file = zip_source_buffer(zip, text.data(), text.size(), 0);
        if (zip_file_add(zip, name.c_str(), file, ZIP_FL_ENC_UTF_8) < 0)
            throw std::runtime_error("cannot add " + name);
    }
    if (zip_close(zip) != 0)
        throw std::runtime_error("cannot write the zip file");
    zip_stat_t stat;
    zip_source_stat(output, &stat);
    std::vector<std::uint8_t> bytes(stat.size);
    zip_source_open(output);
    zip_source_read(output, bytes.data(), bytes.size());
    zip_source_close(output);
    zip_source_free(output);
    return NSData::dataWithVector(std::move(bytes));
}

inline void writeFile(const std::filesystem::path& path, std::string_view bytes) {
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << bytes;
}

/// A stream that gives its bytes a few at a time, and may fail after the last.
class TextStream final : public ScheduleStream {
public:
    explicit TextStream(std::string bytes, std::size_t pieceLength = 1 << 16)
        : _bytes(std::move(bytes))
        , _pieceLength(pieceLength) {}

    std::size_t read(std::span<char> buffer, std::shared_ptr<NSError>& error) override {
        const std::size_t length =
            std::min({buffer.size(), _pieceLength, _bytes.size() - _position});
        std::copy_n(
            _bytes.begin() + static_cast<std::ptrdiff_t>(_position), length, buffer.begin());
        _position += length;
        if (length == 0)
            error = failure;
        return length;
    }

    std::shared_ptr<NSError> failure;

private:
    std::string _bytes;
    std::size_t _pieceLength;
    std::size_t _position = 0;
};

/// A small schedule that is right in every way.
inline Files smallSchedule() {
    return {{"agency.txt",
             "agency_id,agency_name,agency_url,agency_timezone,agency_lang\n"
             "A1,City Lines,https://city.example/,Europe/Paris,fr\n"
             "A2,River Boats,https://boats.example/,Europe/Paris,fr\n"},
            {"routes.txt",
             "route_id,agency_id,route_short_name,route_long_name,route_type,route_color,"
             "route_text_color\n"
             "R1,A1,1,Gare - Mairie,3,005CA9,FFFFFF\n"
             "R2,A1,T2,Hôpital - Université,0,FFB900,\n"
             "R3,A2,,Traversée du port,4,,\n"}};
}

/// The same files, one of them with another text; an empty text takes it away.
inline Files withFile(Files files, const std::string& name, const std::string& text) {
    std::erase_if(files, [&](const auto& file) { return file.first == name; });
    if (!text.empty())
        files.emplace_back(name, text);
    return files;
}

/// A schedule as it was read, or why it was refused.
struct ReadSchedule {
    ScheduleContents contents;
    std::string error;
};

inline ReadSchedule readSchedule(const Files& files, const ImportOptions& options = {}) {
    std::shared_ptr<NSError> error;
    auto contents = ScheduleReader("city", options)
                        .read(ScheduleSource::fromBytes(zipOf(files), "city.zip"), error);
    if (!contents)
        return {{}, error->localizedDescription()};
    return {std::move(*contents), {}};
}

/// The folder of captured feeds; empty without one.
inline std::filesystem::path capturedFeeds() {
    const char* folder = std::getenv("ORVO_TEST_FEEDS");
    if (!folder || !std::filesystem::exists(folder))
        return {};
    return folder;
}

} // namespace orvo::testing
