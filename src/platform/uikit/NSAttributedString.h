#pragma once

#include "platform/foundation/NSObject.h"

#include <map>
#include <string>
#include <vector>

namespace orvo {

/// A stretch of text, counted in bytes of its UTF-8.
struct NSRange {
    std::size_t location = 0;
    std::size_t length = 0;

    [[nodiscard]] std::size_t end() const noexcept { return location + length; }
    friend bool operator==(const NSRange&, const NSRange&) = default;
};

inline constexpr const char* NSFontAttributeName = "NSFont";
inline constexpr const char* NSParagraphStyleAttributeName = "NSParagraphStyle";

class NSMutableAttributedString;

/// Text whose stretches carry attributes by name. Immutable but as `NSMutableAttributedString`.
class NSAttributedString : public virtual NSCopying {
public:
    using Attributes = std::map<std::string, std::shared_ptr<NSObject>>;
    /// A stretch with one set of attributes.
    struct Run {
        NSRange range;
        Attributes attributes;
    };

    [[nodiscard]] static std::shared_ptr<NSAttributedString> initWithString(std::string string);
    [[nodiscard]] static std::shared_ptr<NSAttributedString>
    initWithString_attributes(std::string string, Attributes attributes);

    [[nodiscard]] const std::string& string() const noexcept { return _string; }
    /// In bytes.
    [[nodiscard]] std::size_t length() const noexcept { return _string.size(); }
    /// Covering the text from its start without a gap; none for an empty text.
    [[nodiscard]] const std::vector<Run>& runs() const noexcept { return _runs; }
    /// Nil where the text has none at `index`. `effectiveRange`, unless nil, becomes the stretch
    /// that has the same attributes.
    /// @throws NSInvalidArgumentException past the end
    [[nodiscard]] std::shared_ptr<NSObject> attribute_atIndex_effectiveRange(
        const std::string& name, std::size_t index, NSRange* effectiveRange) const;

    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;
    [[nodiscard]] std::shared_ptr<NSMutableAttributedString> mutableCopy() const;
    /// By text and attributes.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    friend class NSMutableAttributedString;

    std::string _string;
    std::vector<Run> _runs;
};

class NSMutableAttributedString final : public NSAttributedString {
public:
    /// Replaces what the range had under that name.
    /// @throws NSInvalidArgumentException for nil, or a range past the end
    void addAttribute_value_range(const std::string& name,
                                  const std::shared_ptr<NSObject>& value,
                                  NSRange range);

private:
    friend class NSAttributedString;

    void splitAt(std::size_t index);
};

} // namespace orvo
