#include "platform/feeds/schedule/private/ZipLibrary.h"

#include <dlfcn.h>

namespace orvo {

namespace {

struct OpenedZipLibrary {
    std::string reason; // before the library: filled while that is opened
    std::optional<ZipLibrary> library = ZipLibrary::named(ORVO_ZIP_LIBRARY, reason);
};

template <typename Function>
bool find(void* library, const char* name, Function& function) {
    function = reinterpret_cast<Function>(dlsym(library, name));
    return function != nullptr;
}

/// Of the latest call that failed, on this thread.
std::string loaderReason() {
    const char* const reason = dlerror();
    return reason ? reason : "unknown";
}

} // namespace

const ZipLibrary* ZipLibrary::shared(std::string& reason) {
    static const OpenedZipLibrary opened;
    if (opened.library)
        return &*opened.library;
    reason = opened.reason;
    return nullptr;
}

std::optional<ZipLibrary> ZipLibrary::named(const std::string& name, std::string& reason) {
    void* const opened = dlopen(name.c_str(), RTLD_LAZY | RTLD_LOCAL);
    ZipLibrary library;
    const bool isWhole = opened && find(opened, "zip_discard", library.discard) &&
                         find(opened, "zip_error_init", library.errorInit) &&
                         find(opened, "zip_error_fini", library.errorFini) &&
                         find(opened, "zip_error_code_zip", library.errorCodeZip) &&
                         find(opened, "zip_error_strerror", library.errorText) &&
                         find(opened, "zip_fclose", library.closeFile) &&
                         find(opened, "zip_file_get_error", library.fileError) &&
                         find(opened, "zip_fopen_index", library.openFile) &&
                         find(opened, "zip_fread", library.read) &&
                         find(opened, "zip_get_error", library.archiveError) &&
                         find(opened, "zip_get_num_entries", library.entryCount) &&
                         find(opened, "zip_open_from_source", library.open) &&
                         find(opened, "zip_source_buffer_create", library.bufferSource) &&
                         find(opened, "zip_source_file_create", library.fileSource) &&
                         find(opened, "zip_source_free", library.freeSource) &&
                         find(opened, "zip_stat_index", library.statistics);
    if (isWhole)
        return library;
    reason = loaderReason();
    if (opened)
        dlclose(opened);
    return std::nullopt;
}

} // namespace orvo
