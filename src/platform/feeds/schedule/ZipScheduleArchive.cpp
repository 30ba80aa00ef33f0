#include "platform/feeds/schedule/ZipScheduleArchive.h"

#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/ScheduleText.h"
#include "platform/feeds/schedule/private/ZipLibrary.h"

#include <array>
#include <fmt/format.h>
#include <fstream>
#include <utility>

namespace orvo {

struct ZipScheduleArchive::Zip {
    const ZipLibrary& library;
    zip_t* handle = nullptr;
    std::shared_ptr<NSData> bytes;

    explicit Zip(const ZipLibrary& openedLibrary)
        : library(openedLibrary) {}
    Zip(const Zip&) = delete;
    Zip& operator=(const Zip&) = delete;
    ~Zip() {
        if (handle)
            library.discard(handle);
    }
};

namespace {

/// The library's error, as text.
class ZipError {
public:
    explicit ZipError(const ZipLibrary& library)
        : _library(library) {
        _library.errorInit(&_error);
    }
    ZipError(const ZipError&) = delete;
    ZipError& operator=(const ZipError&) = delete;
    ~ZipError() { _library.errorFini(&_error); }

    zip_error_t* get() { return &_error; }
    [[nodiscard]] bool isNoArchive() const {
        return _library.errorCodeZip(&_error) == ZIP_ER_NOZIP;
    }
    std::string text() { return _library.errorText(&_error); }

private:
    const ZipLibrary& _library;
    zip_error_t _error{};
};

class ZipStream final : public ScheduleStream {
public:
    ZipStream(const ZipLibrary& library, zip_file_t* file, std::string name)
        : _library(library)
        , _file(file)
        , _name(std::move(name)) {}
    ~ZipStream() override { _library.closeFile(_file); }

    std::size_t read(std::span<char> buffer, std::shared_ptr<NSError>& error) override {
        const zip_int64_t read = _library.read(_file, buffer.data(), buffer.size());
        if (read >= 0)
            return static_cast<std::size_t>(read);
        error = scheduleError(ScheduleErrorCode::CannotRead,
                              fmt::format("{}: cannot be inflated: {}",
                                          _name,
                                          _library.errorText(_library.fileError(_file))));
        return 0;
    }

private:
    const ZipLibrary& _library;
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
    return {head.data(), static_cast<std::size_t>(file.gcount())};
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

zip_t* openZip(const ZipLibrary& library, const ScheduleSource& source, ZipError& failure) {
    zip_source_t* input =
        source.bytes()
            ? library.bufferSource(
                  source.bytes()->bytes().data(), source.bytes()->length(), 0, failure.get())
            : library.fileSource(source.path().c_str(), 0, 0, failure.get());
    if (!input)
        return nullptr;
    zip_t* zip = library.open(input, ZIP_RDONLY, failure.get());
    if (!zip)
        library.freeSource(input);
    return zip;
}

std::vector<ArchiveEntry> listEntries(const ZipLibrary& library, zip_t* zip) {
    std::vector<ArchiveEntry> entries;
    const zip_int64_t count = library.entryCount(zip, 0);
    for (zip_int64_t index = 0; index < count; ++index) {
        zip_stat_t stat{};
        const auto number = static_cast<zip_uint64_t>(index);
        if (library.statistics(zip, number, ZIP_FL_ENC_GUESS, &stat) != 0 || !stat.name)
            continue;
        const bool hasSize = (stat.valid & ZIP_STAT_SIZE) != 0;
        entries.push_back({stat.name, number, hasSize ? stat.size : 0});
    }
    return entries;
}

std::string whyClosed(const ZipLibrary& library, zip_error_t* failure) {
    const int code = library.errorCodeZip(failure);
    if (code == ZIP_ER_NOPASSWD || code == ZIP_ER_ENCRNOTSUPP)
        return "is encrypted; only archives without a password can be read";
    return fmt::format("cannot be opened: {}", library.errorText(failure));
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
    std::string reason;
    const auto* const library = ZipLibrary::shared(reason);
    if (!library) {
        error = scheduleError(ScheduleErrorCode::CannotRead,
                              source.name() + ": no zip file can be read: " + reason);
        return nullptr;
    }
    ZipError failure(*library);
    const auto zip = std::make_shared<Zip>(*library);
    zip->bytes = source.bytes();
    zip->handle = openZip(*library, source, failure);
    std::vector<ArchiveEntry> entries;
    if (zip->handle)
        entries = listEntries(*library, zip->handle);
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
    const auto& library = _zip->library;
    zip_file_t* opened = library.openFile(_zip->handle, layout().entry(file)->number, 0);
    if (!opened) {
        error = scheduleError(
            ScheduleErrorCode::CannotRead,
            fmt::format("{}: {}", name, whyClosed(library, library.archiveError(_zip->handle))));
        return nullptr;
    }
    return std::make_unique<ZipStream>(library, opened, name);
}

} // namespace orvo
