#pragma once

#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/feeds/schedule/ScheduleLine.h"
#include "platform/foundation/SeededStringHash.h"

#include <cstddef>
#include <string>
#include <vector>

namespace orvo {

/// Gives the lines of one schedule the names that it has for them in the person's language: the
/// exact tag, else the same language and script, else the same language. A line without such a name
/// keeps its own, and so do all where the schedule itself is in that language.
class LineTranslator {
public:
    /// Both languages are BCP-47 tags; `scheduleLanguage` may be empty.
    LineTranslator(const std::vector<ScheduleTranslation>& translations,
                   const std::string& scheduleLanguage,
                   const std::string& personLanguage);

    void translate(ScheduleLine& line) const;

private:
    struct Choice {
        int rank = 0;
        std::string text;
    };
    void replace(std::string& text,
                 const std::string& table,
                 const std::string& field,
                 const std::string& recordId) const;

    // By table, field, and the record or the text that is translated.
    SeededTextMap<std::string, Choice> _choices;
};

/// How well a text in `offered` suits a reader of `wanted` (BCP-47 tags, `_` as `-`, case does not
/// count): 3 the same tag, 2 the same language and script, 1 the same language, 0 another one.
[[nodiscard]] int languageMatch(const std::string& wanted, const std::string& offered);

} // namespace orvo
