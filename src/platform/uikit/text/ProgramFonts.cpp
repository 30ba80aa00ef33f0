#include "platform/uikit/text/private/ProgramFonts.h"

#include <QCoreApplication>
#include <QFontDatabase>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <fontconfig/fontconfig.h>

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

    [[nodiscard]] const Face& nearest(int weight) const {
        return *std::ranges::min_element(
            _faces, {}, [weight](const Face& face) { return std::abs(face.weight - weight); });
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
        readSet();
        if (!_haveSystemFonts && std::ranges::any_of(_faces, &QString::isEmpty, &Face::family))
            readSystemFonts();
    }

    /// A configuration in which nothing stands: the toolkit takes the current one as it finds it.
    static void useNoOtherFonts() {
        auto* const empty = FcConfigCreate();
        FcConfigSetRescanInterval(empty, NeverLookedAtAgain);
        FcConfigSetCurrent(empty);
        FcConfigDestroy(empty); // our reference
    }

    /// All faces at once: whenever one is added, the toolkit forgets every font that it has opened,
    /// and opens it again beside the one that a text still holds.
    void readSet() {
        std::ranges::transform(Files, _identifiers.begin(), [](const FaceFile& file) {
            return QFontDatabase::addApplicationFont(file.path);
        });
        for (std::size_t i = 0; i < Files.size(); ++i)
            _faces.at(i) = {QFontDatabase::applicationFontFamilies(_identifiers.at(i)).value(0, ""),
                            Files.at(i).weight};
    }

    void readSystemFonts() {
        _haveSystemFonts = true;
        FcInitReinitialize();
        // The toolkit looks for fonts anew only when some of its own have gone.
        for (const int identifier : _identifiers)
            QFontDatabase::removeApplicationFont(identifier);
        readSet();
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
