#pragma once

#include <optional>
#include <string>
#include <zip.h>

namespace orvo {

/// What reading an archive needs of libzip. The library is opened when the first archive is: it
/// brings another for encrypted archives, and both together would cost every start milliseconds and
/// more than a megabyte. Immutable; any thread.
struct ZipLibrary {
    decltype(&zip_discard) discard = nullptr;
    decltype(&zip_error_init) errorInit = nullptr;
    decltype(&zip_error_fini) errorFini = nullptr;
    decltype(&zip_error_code_zip) errorCodeZip = nullptr;
    decltype(&zip_error_strerror) errorText = nullptr;
    decltype(&zip_fclose) closeFile = nullptr;
    decltype(&zip_file_get_error) fileError = nullptr;
    decltype(&zip_fopen_index) openFile = nullptr;
    decltype(&zip_fread) read = nullptr;
    decltype(&zip_get_error) archiveError = nullptr;
    decltype(&zip_get_num_entries) entryCount = nullptr;
    decltype(&zip_open_from_source) open = nullptr;
    decltype(&zip_source_buffer_create) bufferSource = nullptr;
    decltype(&zip_source_file_create) fileSource = nullptr;
    decltype(&zip_source_free) freeSource = nullptr;
    decltype(&zip_stat_index) statistics = nullptr;

    /// The library that the program was built with; opened once, and kept. Nullptr where it cannot
    /// be opened: `reason` says why.
    [[nodiscard]] static const ZipLibrary* shared(std::string& reason);
    /// Opens the library of this file name. Nothing where it or a function is missing: `reason`
    /// says which.
    [[nodiscard]] static std::optional<ZipLibrary> named(const std::string& name,
                                                         std::string& reason);
};

} // namespace orvo
