#include "platform/uikit/text/private/ProgramFonts.h"

#include <QCoreApplication>
#include <QFontDatabase>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <fontconfig/fontconfig.h>
#include <utility>

namespace orvo::ProgramFonts {

namespace {

// Static faces: the toolkit emboldens the bold of the variable font a second time.
struct FaceFile {
    int weight;
    const char* path;
};
constexpr std::array Files{FaceFile{400, "/usr/share/fonts/opentype/inter/Inter-Regular.otf"},
                           FaceFile{500, "/usr/share/fonts/opentype/inter/Inter-Medium.otf"},
                           FaceFile{600, "/usr/share/fonts/opentype/inter/Inter-SemiBold.otf"},
                           FaceFile{700, "/usr/share/fonts/opentype/inter/Inter-Bold.otf"}};

// All before bold, which no row has: a start need not read it.
constexpr std::size_t FacesOfRows = 3;

constexpr int NeverLookedAtAgain = 0;
constexpr char16_t LastPlainCharacter = 0x7E; // every font has the characters until this one

/// Line breaks have no glyph, and the toolkit looks for none.
bool isLineBreak(char32_t character) {
    return character == QChar::LineSeparator || character == QChar::ParagraphSeparator;
}

bool showsToolkitWidgets() {
    return QCoreApplication::instance()->inherits("QApplication");
}

class Fonts {
public:
    static Fonts& shared() {
        static Fonts fonts;
        return fonts;
    }

    [[nodiscard]] const Face& nearest(int weight) {
        const auto* const file = std::ranges::min_element(
            Files, {}, [weight](const FaceFile& other) { return std::abs(other.weight - weight); });
        const auto index = static_cast<std::size_t>(file - Files.begin());
        if (index >= _readFaces)
            readFaces(Files.size());
        return _faces.at(index);
    }

    void makeReadyFor(const QString& text) {
        if (!_haveSystemFonts && lacksSomethingOf(text))
            readSystemFonts();
    }

    [[nodiscard]] bool haveSystemFonts() const noexcept { return _haveSystemFonts; }

private:
    Fonts() {
        if (showsToolkitWidgets())
            _haveSystemFonts = true;
        else
            useNoOtherFonts();
        readFaces(FacesOfRows);
    }

    /// A configuration in which nothing stands: the toolkit takes the current one as it finds it.
    static void useNoOtherFonts() {
        auto* const empty = FcConfigCreate();
        FcConfigSetRescanInterval(empty, NeverLookedAtAgain);
        FcConfigSetCurrent(empty);
        FcConfigDestroy(empty); // our reference
    }

    /// Together: whenever one is added, the toolkit forgets every font that it has opened, and
    /// opens it again beside the one that a text still holds.
    void readFaces(std::size_t count) {
        const auto first = _readFaces;
        for (; _readFaces < count; ++_readFaces)
            _identifiers.at(_readFaces) =
                QFontDatabase::addApplicationFont(Files.at(_readFaces).path);
        bool isMissing = false;
        for (auto i = first; i < count; ++i) {
            _faces.at(i) = {QFontDatabase::applicationFontFamilies(_identifiers.at(i)).value(0, ""),
                            Files.at(i).weight};
            isMissing |= _faces.at(i).family.isEmpty();
        }
        if (isMissing && !_haveSystemFonts)
            readSystemFonts();
    }

    void readSystemFonts() {
        _haveSystemFonts = true;
        FcInitReinitialize();
        // The toolkit looks for fonts anew only when some of its own have gone.
        const auto count = std::exchange(_readFaces, 0);
        for (std::size_t i = 0; i < count; ++i)
            QFontDatabase::removeApplicationFont(_identifiers.at(i));
        readFaces(count);
    }

    static bool lacksSomethingOf(const QString& text) {
        for (qsizetype i = 0; i < text.size(); ++i) {
            if (text[i].unicode() <= LastPlainCharacter)
                continue;
            char32_t character = text[i].unicode();
            if (text[i].isHighSurrogate() && i + 1 < text.size() && text[i + 1].isLowSurrogate()) {
                character = QChar::surrogateToUcs4(text[i], text[i + 1]);
                ++i;
            }
            if (!isLineBreak(character) && !isInEveryFace(character))
                return true;
        }
        return false;
    }

    static bool isInEveryFace(char32_t character) {
        const auto* const set = FcConfigGetFonts(nullptr, FcSetApplication);
        if (!set)
            return false;
        return std::all_of(set->fonts, set->fonts + set->nfont, [character](FcPattern* face) {
            FcCharSet* characters = nullptr;
            return FcPatternGetCharSet(face, FC_CHARSET, 0, &characters) == FcResultMatch &&
                   FcCharSetHasChar(characters, character) == FcTrue;
        });
    }

    bool _haveSystemFonts = false;
    std::size_t _readFaces = 0;
    std::array<int, Files.size()> _identifiers{};
    std::array<Face, Files.size()> _faces;
};

} // namespace

const Face& faceOf(int weight) {
    return Fonts::shared().nearest(weight);
}

void makeReadyFor(const QString& text) {
    Fonts::shared().makeReadyFor(text);
}

bool haveSystemFonts() {
    return Fonts::shared().haveSystemFonts();
}

} // namespace orvo::ProgramFonts
