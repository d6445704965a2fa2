// The copy calls' transfer modes, one row at a time on 32-bit words (0xAARRGGBB). Alpha
// is ignored on the way in; every word written is opaque.
#pragma once

#include <Velmar/MacTypes.h>

#include <QColor>

namespace Velmar::Private {

// The current port's colours as the modes use them.
struct TransferInk {
    QRgb fore = 0xFF000000u;
    QRgb back = 0xFFFFFFFFu;
    QRgb op = 0xFF000000u; // blend weight and pin limit
    // Fore not black or back not white: the boolean modes tint what they copy.
    bool colourises() const { return (fore & 0xFFFFFF) != 0 || (back & 0xFFFFFF) != 0xFFFFFF; }
};

// Combines `count` source words into the destination words.
using RowTransfer = void (*)(const QRgb* src, QRgb* dst, int count, const TransferInk& ink);

// The row function for `mode` (ditherCopy ignored). A mode the library does not know is
// logged in the NotImpl category under `call` and copies as srcCopy.
RowTransfer rowTransferFor(SInt16 mode, const char* call);
// True unless the row function's result depends on the source words alone (the copy
// modes): rows copied from one source row are then the same and can be copied once.
bool transferReadsDestination(RowTransfer transfer);
// Lays `copied` over the destination words, each component in proportion to how dark the
// mask's component is (black: all of it, white: none).
void maskRow(const QRgb* copied, const QRgb* mask, QRgb* dst, int count);
// srcCopy without tinting: the words, made opaque.
void copyRowOpaque(const QRgb* src, QRgb* dst, int count, const TransferInk&);

} // namespace Velmar::Private
