#pragma once

#include "platform/feeds/alerts/Alert.h"
#include "platform/foundation/SeededStringHash.h"

#include <array>
#include <span>
#include <string>
#include <string_view>
#include <utility>

namespace orvo {

/// Which of several translations is taken. Tags are compared without regard to case, `_` stands for
/// `-`. A variant that is HTML (`en-html`) is taken only where there is no other. Not safe to share
/// between threads: it remembers the tags that it has seen.
class LanguagePreference {
public:
    LanguagePreference(LanguagePreference&&) = default;
    LanguagePreference& operator=(LanguagePreference&&) = default;
    ~LanguagePreference() = default;

    /// The text for the person: the exact tag, the same language and script, the same language, the
    /// agency's language, untagged, English, the first.
    [[nodiscard]] static LanguagePreference forPerson(std::string_view person,
                                                      std::string_view agency);
    /// The text that stands for the content, whoever reads it: in the agency's language, else the
    /// first.
    [[nodiscard]] static LanguagePreference forAgency(std::string_view agency);

    /// A header with its description. Nil where there is none.
    struct Pair {
        const AlertText* header = nullptr;
        const AlertText* description = nullptr;
    };

    /// Nil for an empty list. Of equally good ones the first.
    [[nodiscard]] const AlertText* best(std::span<const AlertText> texts) const;
    /// Both in one language wherever there is one that has both, in the order of preference; each
    /// for itself where there is none.
    [[nodiscard]] Pair bestPair(std::span<const AlertText> headers,
                                std::span<const AlertText> descriptions) const;
    /// The text of the same tag as `model`, else of the same language. Nil where there is none.
    [[nodiscard]] const AlertText* like(const AlertText& model,
                                        std::span<const AlertText> texts) const;

    /// In small letters, with `-` between the parts and without what is no part of a tag.
    [[nodiscard]] static std::string normalisedTag(std::string_view tag);
    /// Whether both are the same once normalised.
    [[nodiscard]] static bool isSameTag(std::string_view one, std::string_view other) noexcept;

private:
    struct Language {
        std::string tag;      ///< normalised, without `-html`; empty when untagged
        std::string language; ///< `zh`
        std::string script;   ///< `Hant`, the likely one where the tag does not say
        bool isHTML = false;
        int rank = 0; ///< smaller is better
    };

    LanguagePreference() = default;
    [[nodiscard]] static Language languageOf(std::string_view tag);
    [[nodiscard]] const Language& known(std::string_view tag) const;
    [[nodiscard]] int rankOf(const Language& language) const;

    Language _person;
    Language _agency;
    bool _isForPerson = true;
    mutable SeededTextMap<std::string_view, Language> _known; // views into the messages
    /// Those last asked for: most messages have two languages, which take turns.
    mutable std::array<const std::pair<const std::string_view, Language>*, 2> _recent{};
};

} // namespace orvo
