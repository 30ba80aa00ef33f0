#pragma once

#include <QString>

namespace orvo::ProgramFonts {

/// One face of the program's font set.
struct Face {
    QString family; ///< empty where the set is not installed: the toolkit's own choice
    int weight = 0;
};

/// The one of the nearest weight. The first call reads those of up to semibold, the first that is
/// bolder the rest; and as long as the set is enough, no other font: reading the system's costs a
/// start more than all else. They are read at once where the set is not installed, and where the
/// toolkit's own widgets are shown, which write in them. Main thread, with a graphical application
/// object.
[[nodiscard]] const Face& faceOf(int weight);

/// To be called before a text is shaped: reads the system's fonts when the set lacks one of its
/// characters. Whatever the set has is written as before. Main thread, with a graphical
/// application object.
void makeReadyFor(const QString& text);

/// Whether the system's fonts have been read.
[[nodiscard]] bool haveSystemFonts();

} // namespace orvo::ProgramFonts
