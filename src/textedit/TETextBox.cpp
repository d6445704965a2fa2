// TETextBox: text drawn into the current port, broken into lines within a box.
#include <Velmar/QtGrafPort.h>
#include <Velmar/TextEdit.h>
#include <Velmar/TextUtils.h>

#include "foundation/Conversions.h"
#include "quickdraw/ShapeLog.h"
#include "textedit/TERecordPrivate.h"

#include <QRegularExpression>

namespace Velmar {

using namespace Private;

void TETextBox(const void* text, SInt32 length, const Rect* box, SInt16 just)
{
    if (length <= 0) {
        shapeWarning("warning: Velmar::TETextBox: count is less or zero");
        return;
    }
    MakeQPainter painter("TETextBox");
    if (!painter || !text)
        return;
    static const QRegularExpression sBreaks(QStringLiteral("\r\n|\n\r|\r"));
    QString lines = MakeQString(static_cast<const char*>(text), length);
    lines.replace(sBreaks, QStringLiteral("\n"));
    const QRect area = box ? toQRect(*box) : QRect();
    painter->drawText(area, int(alignmentForJust(just) | Qt::AlignTop | Qt::TextWordWrap), lines);
    painter |= area;
}

} // namespace Velmar
