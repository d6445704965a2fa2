// The font table: Toolbox font IDs and names against Qt families and style hints.
#pragma once

#include <Velmar/MacTypes.h>

#include <QFont>
#include <QString>

namespace Velmar::Private {

struct FontRow {
    SInt16 id;
    QString toolboxName;
    QString family;
    QFont::StyleHint hint;
};

// Families Qt knows beyond the fixed rows get IDs from here up, in the order Qt lists them.
inline constexpr SInt16 kFirstAddedFontId = 256;

// The row of `id`, or null (logging "getFontName(): Unknown font ID - <id>").
const FontRow* fontRowById(SInt16 id);
// The same without a log line, for callers with a fallback of their own.
const FontRow* findFontRow(SInt16 id);
// The ID whose Toolbox name is `name` (exact first, then ignoring case); -1 when none.
SInt16 fontIdByToolboxName(const QString& name);
// The first ID whose Qt family is `family` (ignoring case); -1 when none.
SInt16 fontIdByFamily(const QString& family);

// The number of rows (fixed and added), and row `index` of them in table order.
int fontRowCount();
const FontRow& fontRowAt(int index);

} // namespace Velmar::Private
