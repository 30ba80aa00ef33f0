#include "platform/feeds/schedule/CsvReader.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Row = std::vector<std::string>;

/// Gives the bytes in pieces of one length.
class PieceStream final : public orvo::ScheduleStream {
public:
    PieceStream(std::string_view bytes, std::size_t pieceLength)
        : _bytes(bytes)
        , _pieceLength(pieceLength) {}

    std::size_t read(std::span<char> buffer, std::shared_ptr<orvo::NSError>& /*error*/) override {
        const std::size_t length = std::min({buffer.size(), _pieceLength, _bytes.size()});
        std::copy_n(_bytes.begin(), length, buffer.begin());
        _bytes.remove_prefix(length);
        return length;
    }

private:
    std::string_view _bytes;
    std::size_t _pieceLength;
};

struct Read {
    std::vector<Row> rows;
    std::string error;

    bool operator==(const Read&) const = default;
};

Read readAll(std::string_view bytes, std::size_t pieceLength) {
    PieceStream stream(bytes, pieceLength);
    orvo::CsvReader reader(stream, "file");
    Read read;
    std::shared_ptr<orvo::NSError> error;
    while (reader.next(error)) {
        Row row;
        for (std::size_t index = 0; index < reader.fieldCount(); ++index) {
            row.emplace_back(reader.field(index));
            if (!orvo::Text::isValidUTF8(row.back()))
                std::abort();
        }
        read.rows.push_back(std::move(row));
    }
    if (error)
        read.error = error->localizedDescription();
    return read;
}

std::string written(const std::vector<Row>& rows) {
    std::string text;
    for (const Row& row : rows) {
        for (std::size_t index = 0; index < row.size(); ++index) {
            text += index == 0 ? "\"" : ",\"";
            for (const char character : row[index])
                text.append(character == '"' ? 2 : 1, character);
            text += '"';
        }
        text += '\n';
    }
    return text;
}

} // namespace

/// However the bytes are cut into pieces, the rows are the same; and rows that are written out
/// quoted are read as the same again.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const Read whole = readAll(bytes, std::max(size, std::size_t{1}));
    for (const std::size_t pieceLength : {1U, 3U})
        if (readAll(bytes, pieceLength) != whole)
            std::abort();
    const Read again = readAll(written(whole.rows), std::size_t{1} << 16);
    if (again.rows != whole.rows || !again.error.empty())
        std::abort();
    return 0;
}
