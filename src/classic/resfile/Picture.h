// QuickDraw pictures ('PICT', versions 1 and 2) played back through the library's public
// QuickDraw calls into the current port.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>

#include <QByteArray>
#include <QImage>
#include <QString>

namespace Velmar::Classic {

// A classic pattern (eight rows, most significant bit leftmost, set bits in the pen colour)
// as the library's Pattern, which PenPat, BackPat and FillRect take.
Pattern classicPattern(const UInt8 (&bits)[8]);

// The frame the picture was recorded in; an empty rectangle when the data is too short.
Rect pictureFrame(const QByteArray& pict);

// Plays the picture into the current port, mapped from its frame onto `destination` as
// DrawPicture does. The port's pen, text, colours, clip and origin are restored afterwards.
// False when there is no current port or the data is not a picture; a picture cut short or
// holding an opcode whose length cannot be known draws what came before it and answers true.
bool drawPicture(const QByteArray& pict, const Rect& destination);

// The picture drawn at its own size on white, in an offscreen world of its own (needs a
// QGuiApplication). A null image, with a reason, when nothing could be drawn.
QImage pictureImage(const QByteArray& pict, QString* error = nullptr);

} // namespace Velmar::Classic
