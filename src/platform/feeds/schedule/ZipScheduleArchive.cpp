#include "platform/feeds/schedule/ZipScheduleArchive.h"

#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/ScheduleText.h"

#include <array>
#include <fmt/format.h>
#include <fstream>
#include <utility>
#include <zip.h>

namespace orvo {

struct ZipScheduleArchive::Zip {
    zip_t* handle = nullptr;
    std::shared_ptr<NSData> bytes;

    Zip() = default;
    Zip(const Zip&) = delete;
    Zip& operator=(const Zip&) = delete;
    ~Zip() {
        if (handle)
            zip_discard(handle);
    }
};

namespace {

/// The library's error, as text.
class ZipError {
public:
    ZipError() { zip_error_init(&_error); }
    ZipError(const ZipError&) = delete;
    ZipError& operator=(const ZipError&) = delete;
    ~ZipError() { zip_error_fini(&_error); }

    zip_error_t* get() { return &_error; }
    bool isNoArchive() const { return zip_error_code_zip(&_error) == ZIP_ER_NOZIP; }
    std::string text() { return zip_error_strerror(&_error); }

private:
    zip_error_t _error;
};

class ZipStream final : public ScheduleStream {
public:
    ZipStream(zip_file_t* file, std::string name)
        : _file(file)
        , _name(std::move(name)) {}
    ~ZipStream() override { zip_fclose(_file); }

    std::size_t read(std::span<char> buffer, std::shared_ptr<NSError>& error) override {
        const zip_int64_t read = zip_fread(_file, buffer.data(), buffer.size());
        if (read >= 0)
            return static_cast<std::size_t>(read);
        error = scheduleError(ScheduleErrorCode::CannotRead,
                              fmt::format("{}: cannot be inflated: {}",
                                          _name,
                                          zip_error_strerror(zip_file_get_error(_file))));
        return 0;
    }

private:
    zip_file_t* _file;
    std::string _name;
};

constexpr std::size_t HeadLength = 64;

std::string headOf(const ScheduleSource& source) {
    if (source.bytes())
        return std::string(source.bytes()->stringView().substr(0, HeadLength));
    std::array<char, HeadLength> head{};
    std::ifstream file(source.path(), std::ios::binary);
    file.read(head.data(), head.size());
    return std::string(head.data(), static_cast<std::size_t>(file.gcount()));
}

/// What a person should know about bytes that are no zip file.
std::string whatItIs(std::string_view head) {
    const std::string text = ScheduleText::asciiLowercase(ScheduleText::trimmed(head));
    if (head.empty())
        return "is empty";
    if (head.starts_with("PK"))
        return "begins like a zip file but is empty, cut off or damaged";
    if (head.starts_with("\x1F\x8B"))
        return "is a gzip file, not a zip file";
    if (text.starts_with("<!doctype") || text.starts_with("<html"))
        return "is a web page, not a zip file";
    return fmt::format("is not a zip file; it begins with “{}”",
                       ScheduleText::cleanName(head.substr(0, 20)));
}

zip_t* openZip(const ScheduleSource& source, ZipError& failure) {
    zip_source_t* input =
        source.bytes()
            ? zip_source_buffer_create(
                  source.bytes()->bytes().data(), source.bytes()->length(), 0, failure.get())
            : zip_source_file_create(source.path().c_str(), 0, 0, failure.get());
    if (!input)
        return nullptr;
    zip_t* zip = zip_open_from_source(input, ZIP_RDONLY, failure.get());
    if (!zip)
        zip_source_free(input);
    return zip;
}

std::vector<ArchiveEntry> listEntries(zip_t* zip) {
    std::vector<ArchiveEntry> entries;
    const zip_int64_t count = zip_get_num_entries(zip, 0);
    for (zip_int64_t index = 0; index < count; ++index) {
        zip_stat_t stat;
        zip_stat_init(&stat);
        const auto number = static_cast<zip_uint64_t>(index);
        if (zip_stat_index(zip, number, ZIP_FL_ENC_GUESS, &stat) != 0 || !stat.name)
            continue;
        const bool hasSize = (stat.valid & ZIP_STAT_SIZE) != 0;
        entries.push_back({stat.name, number, hasSize ? stat.size : 0});
    }
    return entries;
}

} // namespace

ZipScheduleArchive::ZipScheduleArchive(ArchiveLayout layout,
                                       std::shared_ptr<Zip> zip,
                                       std::string name)
    : ScheduleArchive(std::move(layout))
    , _zip(std::move(zip))
    , _name(std::move(name)) {}

std::unique_ptr<ScheduleArchive> ZipScheduleArchive::open(const ScheduleSource& source,
                                                          std::shared_ptr<NSError>& error) {
    ZipError failure;
    const auto zip = std::make_shared<Zip>();
    zip->bytes = source.bytes();
    zip->handle = openZip(source, failure);
    std::vector<ArchiveEntry> entries;
    if (zip->handle)
        entries = listEntries(zip->handle);
    // The library takes a file without any bytes for an archive without any files.
    if (entries.empty()) {
        const bool isReadable = zip->handle || failure.isNoArchive();
        error = isReadable ? scheduleError(ScheduleErrorCode::NotAnArchive,
                                           source.name() + ": " + whatItIs(headOf(source)))
                           : scheduleError(ScheduleErrorCode::CannotRead,
                                           source.name() + ": " + failure.text());
        return nullptr;
    }
    auto layout = ArchiveLayout::find(std::move(entries), source.name(), error);
    if (!layout)
        return nullptr;
    return std::unique_ptr<ScheduleArchive>(
        new ZipScheduleArchive(std::move(*layout), zip, source.name()));
}

std::unique_ptr<ScheduleStream>
ZipScheduleArchive::openFile(std::string_view file, std::shared_ptr<NSError>& error) const {
    const std::string name = fmt::format("{}: {}", _name, file);
    zip_file_t* opened = zip_fopen_index(_zip->handle, layout().entry(file)->number, 0);
    if (!opened) {
        error = scheduleError(ScheduleErrorCode::CannotRead,
                              fmt::format("{}: cannot be opened: {}",
                                          name,
                                          zip_error_strerror(zip_get_error(_zip->handle))));
        return nullptr;
    }
    return std::make_unique<ZipStream>(opened, name);
}

} // namespace orvo
