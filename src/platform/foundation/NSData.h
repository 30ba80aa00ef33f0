#pragma once

#include "platform/foundation/NSObject.h"

#include <span>
#include <string>
#include <vector>

namespace orvo {

/// Immutable bytes.
class NSData final : public virtual NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSData> dataWithBytes(std::span<const std::uint8_t> bytes);
    [[nodiscard]] static std::shared_ptr<NSData> dataWithString(std::string_view bytes);
    [[nodiscard]] static std::shared_ptr<NSData> dataWithVector(std::vector<std::uint8_t> bytes);
    /// Takes over `length` bytes that `malloc` gave; they are freed with the data, not copied.
    [[nodiscard]] static std::shared_ptr<NSData> dataWithBytesNoCopy(std::uint8_t* bytes,
                                                                     std::size_t length);

    [[nodiscard]] std::span<const std::uint8_t> bytes() const noexcept { return _bytes; }
    [[nodiscard]] std::string_view stringView() const noexcept;
    [[nodiscard]] std::size_t length() const noexcept { return _bytes.size(); }

    ~NSData() override;
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `{length = 3, bytes = 0x010203}`, the middle of long data left out.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::vector<std::uint8_t> _storage;
    std::uint8_t* _owned = nullptr;
    std::span<const std::uint8_t> _bytes;
};

} // namespace orvo
