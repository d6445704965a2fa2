#include "classic/resfile/Picture.h"

namespace Velmar::Classic {
Rect pictureFrame(const QByteArray&) { return Rect{}; }
bool drawPicture(const QByteArray&, const Rect&) { return false; }
QImage pictureImage(const QByteArray&, QString*) { return {}; }
}
