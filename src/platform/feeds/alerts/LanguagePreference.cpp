#include "platform/feeds/alerts/LanguagePreference.h"

#include "platform/feeds/alerts/ByteScan.h"

#include <unicode/uloc.h>

#include <algorithm>
#include <array>
#include <utility>

namespace orvo {

namespace {

constexpr int HTMLPenalty = 100;
constexpr std::string_view HTMLSuffix = "-html";

/// Pairs of codes for one language: an old code, or a language and the form of it that is meant.
std::string_view unaliased(std::string_view language) {
    static constexpr std::array<std::pair<std::string_view, std::string_view>, 6> Aliases = {{
        {"no", "nb"},
        {"iw", "he"},
        {"in", "id"},
        {"ji", "yi"},
        {"mo", "ro"},
        {"tl", "fil"},
    }};
    for (const auto& [alias, language_] : Aliases)
        if (alias == language)
            return language_;
    return language;
}

char normalisedLetter(char c) noexcept {
    if (c >= 'A' && c <= 'Z')
        return static_cast<char>(c - 'A' + 'a');
    return c == '_' || c == '/' ? '-' : c;
}

/// Without those around it.
std::string_view withoutBlanks(std::string_view tag) noexcept {
    tag.remove_prefix(std::min(tag.find_first_not_of(' '), tag.size()));
    return tag.substr(0, tag.find_last_not_of(' ') + 1);
}

using LocaleFunction = int32_t (*)(const char*, char*, int32_t, UErrorCode*);

std::string partOf(const std::string& locale, LocaleFunction part) {
    std::array<char, ULOC_FULLNAME_CAPACITY> buffer{};
    UErrorCode status = U_ZERO_ERROR;
    const int32_t length =
        part(locale.c_str(), buffer.data(), static_cast<int32_t>(buffer.size()), &status);
    if (U_FAILURE(status) || status == U_STRING_NOT_TERMINATED_WARNING)
        return {};
    return {buffer.data(), static_cast<std::size_t>(length)};
}

} // namespace

LanguagePreference LanguagePreference::forPerson(std::string_view person, std::string_view agency) {
    LanguagePreference preference;
    preference._person = languageOf(person);
    preference._agency = languageOf(agency);
    return preference;
}

LanguagePreference LanguagePreference::forAgency(std::string_view agency) {
    LanguagePreference preference;
    preference._agency = languageOf(agency);
    preference._isForPerson = false;
    return preference;
}

const AlertText* LanguagePreference::best(std::span<const AlertText> texts) const {
    const AlertText* best = nullptr;
    int bestRank = 0;
    for (const AlertText& text : texts) {
        const int rank = known(text.language).rank;
        if (!best || rank < bestRank) {
            best = &text;
            bestRank = rank;
        }
    }
    return best;
}

LanguagePreference::Pair
LanguagePreference::bestPair(std::span<const AlertText> headers,
                             std::span<const AlertText> descriptions) const {
    Pair best;
    int bestRank = 0;
    for (const AlertText& header : headers) {
        const int rank = known(header.language).rank;
        if (best.header && rank >= bestRank)
            continue;
        if (const AlertText* const description = like(header, descriptions)) {
            best = {&header, description};
            bestRank = rank;
        }
    }
    return best.header ? best : Pair{this->best(headers), this->best(descriptions)};
}

const AlertText* LanguagePreference::like(const AlertText& model,
                                          std::span<const AlertText> texts) const {
    const Language& wanted = known(model.language);
    const AlertText* sameLanguage = nullptr;
    for (const AlertText& text : texts) {
        const Language& language = known(text.language);
        if (language.tag == wanted.tag && language.isHTML == wanted.isHTML)
            return &text;
        const bool isSame = language.language == wanted.language &&
                            language.script == wanted.script && !wanted.language.empty();
        if (isSame && (!sameLanguage || (known(sameLanguage->language).isHTML && !language.isHTML)))
            sameLanguage = &text;
    }
    return sameLanguage;
}

std::string LanguagePreference::normalisedTag(std::string_view tag) {
    std::string result(withoutBlanks(tag));
    std::ranges::transform(result, result.begin(), normalisedLetter);
    return result;
}

bool LanguagePreference::isSameTag(std::string_view one, std::string_view other) noexcept {
    return one == other ||
           std::ranges::equal(
               withoutBlanks(one), withoutBlanks(other), {}, normalisedLetter, normalisedLetter);
}

LanguagePreference::Language LanguagePreference::languageOf(std::string_view tag) {
    Language result;
    result.tag = normalisedTag(tag);
    if (result.tag == "html" || result.tag.ends_with(HTMLSuffix)) {
        result.isHTML = true;
        result.tag.erase(result.tag == "html" ? 0 : result.tag.size() - HTMLSuffix.size());
    }
    result.language = unaliased(std::string_view(result.tag).substr(0, result.tag.find('-')));
    if (!result.tag.empty())
        result.script = partOf(partOf(result.tag, uloc_addLikelySubtags), uloc_getScript);
    return result;
}

const LanguagePreference::Language& LanguagePreference::known(std::string_view tag) const {
    for (const auto* const recent : _recent)
        if (recent && ByteScan::isEqual(recent->first, tag))
            return recent->second;
    auto found = _known.find(tag);
    if (found == _known.end()) {
        Language language = languageOf(tag);
        language.rank = rankOf(language) + (language.isHTML ? HTMLPenalty : 0);
        found = _known.emplace(tag, std::move(language)).first;
    }
    _recent = {&*found, _recent.front()};
    return found->second;
}

int LanguagePreference::rankOf(const Language& language) const {
    const auto isLike = [&](const Language& wanted) {
        return !wanted.language.empty() && language.language == wanted.language;
    };
    int rank = 0;
    if (_isForPerson) {
        if (!language.tag.empty() && language.tag == _person.tag)
            return rank;
        if (isLike(_person) && language.script == _person.script)
            return rank + 1;
        if (isLike(_person))
            return rank + 2;
        rank += 3;
    }
    if (!language.tag.empty() && language.tag == _agency.tag)
        return rank;
    if (isLike(_agency))
        return rank + 1;
    if (!_isForPerson)
        return rank + 2;
    if (language.tag.empty())
        return rank + 2;
    return language.language == "en" ? rank + 3 : rank + 4;
}

} // namespace orvo
