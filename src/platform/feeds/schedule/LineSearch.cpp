#include "platform/feeds/schedule/LineSearch.h"

#include "platform/foundation/EditDistance.h"
#include "platform/foundation/SeededStringHash.h"

#include <unicode/coleitr.h>
#include <unicode/tblcoll.h>
#include <unicode/uchar.h>

#include <algorithm>
#include <iterator>
#include <optional>
#include <tuple>
#include <utility>

namespace orvo {

namespace {

/// A word as its letters' primary weights: two words with the same ones read alike.
using Word = std::u16string;
using Words = std::vector<Word>;

bool anyBeginsWith(const Words& words, const Word& beginning) {
    return std::ranges::any_of(words,
                               [&](const Word& word) { return word.starts_with(beginning); });
}

bool anyHolds(const Words& words, const Word& part) {
    return std::ranges::any_of(words,
                               [&](const Word& word) { return word.find(part) != Word::npos; });
}

bool beginsWith(const Words& words, const Words& wanted) {
    if (wanted.size() > words.size())
        return false;
    const auto last = static_cast<std::ptrdiff_t>(wanted.size() - 1);
    return std::equal(wanted.begin(), wanted.begin() + last, words.begin()) &&
           words[wanted.size() - 1].starts_with(wanted.back());
}

constexpr std::size_t LettersForOneSlip = 4;
constexpr std::size_t MostSlips = 3;
constexpr std::size_t LongestMisspelt = 40; // longer ones would take long to compare
constexpr std::size_t MostWordsMisspelt = 8;

/// How many letters are wrong, where that is few enough for `wanted` to mean `word`.
std::optional<std::size_t> slipsBetween(const Word& wanted, const Word& word) {
    const auto [shorter, longer] = std::minmax({wanted.size(), word.size()});
    const std::size_t most = std::min(shorter / LettersForOneSlip, MostSlips);
    if (longer - shorter > most || most == 0 || longer > LongestMisspelt)
        return std::nullopt;
    const std::size_t slips = editDistance(wanted, word);
    return slips <= most ? std::optional(slips) : std::nullopt;
}

template <class Predicate>
bool allOf(const Words& wanted, Predicate predicate) {
    return std::ranges::all_of(wanted, predicate);
}

} // namespace

struct LineSearch::Comparer {
    enum Rank : int {
        VeryShortName,
        VeryLongName,
        NameBegins, ///< the short or the long one
        NamesBegin,
        AgencyBegins,
        AnyPlace,
        NoMatch
    };

    std::unique_ptr<icu::RuleBasedCollator> collator;
    std::unique_ptr<icu::CollationElementIterator> elements;
    SeededTextMap<std::string, Words> agencies; // few names, on many lines
    Word digits;                                // those of all scripts weigh the same

    explicit Comparer(const std::string& locale) {
        UErrorCode status = U_ZERO_ERROR;
        const icu::Locale place = icu::Locale::forLanguageTag(locale, status);
        status = U_ZERO_ERROR;
        std::unique_ptr<icu::Collator> made(icu::Collator::createInstance(place, status));
        if (!dynamic_cast<icu::RuleBasedCollator*>(made.get()))
            return;
        collator.reset(static_cast<icu::RuleBasedCollator*>(made.release()));
        collator->setStrength(icu::Collator::PRIMARY);
        elements.reset(collator->createCollationElementIterator(icu::UnicodeString()));
        digits = wordsOf("0123456789").at(0);
    }

    Words wordsOf(std::string_view text) const {
        const auto source = icu::UnicodeString::fromUTF8(
            icu::StringPiece(text.data(), static_cast<int32_t>(text.size())));
        Words words;
        int32_t begin = 0;
        for (int32_t at = 0; at <= source.length(); at = source.moveIndex32(at, 1)) {
            const UChar32 point = at < source.length() ? source.char32At(at) : UChar32{' '};
            const bool isPart = u_isalnum(point) || u_getCombiningClass(point) != 0;
            if (!isPart) {
                addWord(words, source.tempSubStringBetween(begin, at));
                begin = source.moveIndex32(at, 1);
            }
            if (at == source.length())
                break;
        }
        return words;
    }

    const Words& agencyWords(const std::string& name) {
        const auto known = agencies.find(name);
        return known != agencies.end() ? known->second
                                       : agencies.emplace(name, wordsOf(name)).first->second;
    }

    /// How well a line fits, and how many words its name goes on for: the shorter one is meant.
    struct Fit {
        Rank rank = NoMatch;
        std::size_t words = 0;
    };

    Fit fit(const ScheduleLine& line, const Words& wanted) {
        const Words shortName = wordsOf(line.shortName);
        const Words longName = wordsOf(line.longName);
        const Rank rank = rankOf(line, shortName, longName, wanted);
        if (rank != NameBegins)
            return {rank, 0};
        return {rank, beginsWith(shortName, wanted) ? shortName.size() : longName.size()};
    }

    /// How many letters of `wanted` are wrong for this line, and how many words its names have;
    /// nothing where it was not meant.
    std::optional<std::pair<std::size_t, std::size_t>> slips(const ScheduleLine& line,
                                                             const Words& wanted) {
        Words names = wordsOf(line.longName);
        std::ranges::move(wordsOf(line.shortName), std::back_inserter(names));
        const Words& agency = agencyWords(line.agency.name);
        std::size_t total = 0;
        for (const Word& word : wanted) {
            if (isIn(names, word) || isIn(agency, word))
                continue;
            const auto fewest = hasDigit(word) ? std::nullopt : fewestSlips(word, names);
            if (!fewest)
                return std::nullopt;
            total += *fewest;
        }
        return std::pair(total, names.size());
    }

private:
    bool hasDigit(const Word& word) const { return word.find_first_of(digits) != Word::npos; }

    /// A word may be left unfinished, a number not.
    bool isIn(const Words& words, const Word& wanted) const {
        return hasDigit(wanted) ? std::ranges::count(words, wanted) > 0
                                : anyBeginsWith(words, wanted);
    }

    std::optional<std::size_t> fewestSlips(const Word& wanted, const Words& names) const {
        std::optional<std::size_t> fewest;
        for (const Word& name : names) {
            const auto slips = hasDigit(name) ? std::nullopt : slipsBetween(wanted, name);
            if (slips && (!fewest || *slips < *fewest))
                fewest = slips;
        }
        return fewest;
    }

    Rank rankOf(const ScheduleLine& line,
                const Words& shortName,
                const Words& longName,
                const Words& wanted) {
        if (shortName == wanted)
            return VeryShortName;
        if (longName == wanted)
            return VeryLongName;
        if (beginsWith(shortName, wanted) || beginsWith(longName, wanted))
            return NameBegins;
        Words names = longName;
        names.insert(names.end(), shortName.begin(), shortName.end());
        if (allOf(wanted, [&](const Word& word) { return anyBeginsWith(names, word); }))
            return NamesBegin;
        const Words& agency = agencyWords(line.agency.name);
        if (allOf(wanted, [&](const Word& word) {
                return anyBeginsWith(names, word) || anyBeginsWith(agency, word);
            }))
            return AgencyBegins;
        if (allOf(wanted, [&](const Word& word) {
                return anyHolds(names, word) || anyHolds(agency, word);
            }))
            return AnyPlace;
        return NoMatch;
    }

    void addWord(Words& words, const icu::UnicodeString& text) const {
        if (text.isEmpty() || !elements)
            return;
        UErrorCode status = U_ZERO_ERROR;
        elements->setText(text, status);
        Word word;
        for (int32_t element = elements->next(status);
             U_SUCCESS(status) && element != icu::CollationElementIterator::NULLORDER;
             element = elements->next(status))
            if (const int32_t weight = icu::CollationElementIterator::primaryOrder(element))
                word.push_back(static_cast<char16_t>(weight));
        if (!word.empty())
            words.push_back(std::move(word));
    }
};

LineSearch::LineSearch(const std::string& locale)
    : _comparer(std::make_unique<Comparer>(locale)) {}

LineSearch::~LineSearch() = default;

std::vector<ScheduleLine>
LineSearch::best(std::vector<ScheduleLine> lines, std::string_view text, std::size_t limit) {
    const Words wanted = _comparer->wordsOf(text);
    if (wanted.empty())
        return {};
    std::vector<std::tuple<Comparer::Rank, std::size_t, std::size_t>> found;
    for (std::size_t index = 0; index < lines.size(); ++index)
        if (const auto fit = _comparer->fit(lines[index], wanted); fit.rank != Comparer::NoMatch)
            found.emplace_back(fit.rank, fit.words, index);
    std::ranges::sort(found);
    found.resize(std::min(found.size(), limit));
    std::vector<ScheduleLine> best;
    best.reserve(found.size());
    for (const auto& [rank, words, index] : found)
        best.push_back(std::move(lines[index]));
    return best;
}

std::vector<ScheduleLine> LineSearch::named(std::vector<ScheduleLine> lines,
                                            std::string_view name) {
    if (name.empty())
        return {};
    const Words wanted = _comparer->wordsOf(name);
    const auto isNamed = [&](const std::string& text) {
        return text == name || (!wanted.empty() && _comparer->wordsOf(text) == wanted);
    };
    std::erase_if(lines, [&](const ScheduleLine& line) {
        return !isNamed(line.shortName) && !isNamed(line.longName);
    });
    return lines;
}

std::vector<ScheduleLine>
LineSearch::near(std::vector<ScheduleLine> lines, std::string_view text, std::size_t limit) {
    const Words wanted = _comparer->wordsOf(text);
    if (wanted.empty() || wanted.size() > MostWordsMisspelt)
        return {};
    std::vector<std::tuple<std::size_t, std::size_t, std::size_t>> found;
    for (std::size_t index = 0; index < lines.size(); ++index)
        if (const auto slips = _comparer->slips(lines[index], wanted))
            found.emplace_back(slips->first, slips->second, index);
    std::ranges::sort(found);
    found.resize(std::min(found.size(), limit));
    std::vector<ScheduleLine> near;
    near.reserve(found.size());
    for (const auto& [slips, words, index] : found)
        near.push_back(std::move(lines[index]));
    return near;
}

} // namespace orvo
