#include "platform/feeds/schedule/FolderScheduleArchive.h"

#include "platform/feeds/schedule/ScheduleError.h"

#include <cerrno>
#include <cstdio>
#include <system_error>
#include <utility>

namespace orvo {

namespace {

constexpr int DeepestLevel = 2;
constexpr std::size_t MaximumEntries = 100'000;

std::shared_ptr<NSError> cannotRead(const std::string& what, const std::error_code& reason) {
    return scheduleError(ScheduleErrorCode::CannotRead, what + ": " + reason.message());
}

class FileStream final : public ScheduleStream {
public:
    FileStream(std::FILE* file, std::string name)
        : _file(file)
        , _name(std::move(name)) {}
    ~FileStream() override { std::fclose(_file); }

    std::size_t read(std::span<char> buffer, std::shared_ptr<NSError>& error) override {
        const std::size_t read = std::fread(buffer.data(), 1, buffer.size(), _file);
        if (std::ferror(_file) == 0)
            return read;
        error = cannotRead(_name, std::error_code(errno, std::generic_category()));
        return 0;
    }

private:
    std::FILE* _file;
    std::string _name;
};

std::vector<ArchiveEntry> listFiles(const std::filesystem::path& folder, std::error_code& failure) {
    using Iterator = std::filesystem::recursive_directory_iterator;
    std::vector<ArchiveEntry> entries;
    Iterator file(folder, std::filesystem::directory_options::skip_permission_denied, failure);
    for (; !failure && file != Iterator(); file.increment(failure)) {
        if (file.depth() >= DeepestLevel)
            file.disable_recursion_pending();
        if (entries.size() >= MaximumEntries) {
            failure = std::make_error_code(std::errc::argument_list_too_long);
            break;
        }
        std::error_code ignored;
        if (!file->is_regular_file(ignored)) // a pipe would be waited for without end
            continue;
        ArchiveEntry entry;
        entry.path = file->path().lexically_relative(folder).generic_string();
        const auto size = file->file_size(ignored);
        entry.size = ignored ? 0 : size;
        entries.push_back(std::move(entry));
    }
    return entries;
}

} // namespace

FolderScheduleArchive::FolderScheduleArchive(ArchiveLayout layout, std::filesystem::path folder)
    : ScheduleArchive(std::move(layout))
    , _folder(std::move(folder)) {}

std::unique_ptr<ScheduleArchive> FolderScheduleArchive::open(const ScheduleSource& source,
                                                             std::shared_ptr<NSError>& error) {
    std::error_code failure;
    auto entries = listFiles(source.path(), failure);
    if (failure) {
        error = failure == std::errc::argument_list_too_long
                    ? scheduleError(ScheduleErrorCode::TooLarge,
                                    source.name() + ": holds too many files to be a schedule")
                    : cannotRead(source.name(), failure);
        return nullptr;
    }
    auto layout = ArchiveLayout::find(std::move(entries), source.name(), error);
    if (!layout)
        return nullptr;
    return std::unique_ptr<ScheduleArchive>(
        new FolderScheduleArchive(std::move(*layout), source.path()));
}

std::unique_ptr<ScheduleStream>
FolderScheduleArchive::openFile(std::string_view file, std::shared_ptr<NSError>& error) const {
    const std::filesystem::path path = _folder / layout().entry(file)->path;
    std::FILE* opened = std::fopen(path.c_str(), "rbe");
    if (!opened) {
        error = cannotRead(path.string(), std::error_code(errno, std::generic_category()));
        return nullptr;
    }
    return std::make_unique<FileStream>(opened, path.string());
}

} // namespace orvo
