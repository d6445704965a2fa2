// Icon images by type and ID: the path patterns, the style's stop, note and caution icons,
// and the mask rules that give old icon types their transparency.
#include <Velmar/QDIcons.h>
#include <Velmar/TextUtils.h>

#include "resources/ImageCache.h"

#include <QApplication>
#include <QHash>
#include <QIcon>
#include <QPixmap>
#include <QStyle>

namespace Velmar {

using namespace Private;

namespace {

enum class MaskRule {
    None, // 'cicn': drawn as it is
    White, // 'icl4', 'icl8', 'ics4', 'ics8': pure white is transparent
    Inverted, // everything else: black opaque, white transparent, greys in between
};

MaskRule maskRule(ResType type)
{
    switch (type) {
    case FOUR_CHAR_CODE("cicn"): return MaskRule::None;
    case FOUR_CHAR_CODE("icl4"):
    case FOUR_CHAR_CODE("icl8"):
    case FOUR_CHAR_CODE("ics4"):
    case FOUR_CHAR_CODE("ics8"): return MaskRule::White;
    default: return MaskRule::Inverted;
    }
}

bool hasImagePattern(ResType type)
{
    switch (type) {
    case FOUR_CHAR_CODE("cicn"):
    case FOUR_CHAR_CODE("cccn"):
    case FOUR_CHAR_CODE("SICN"):
    case FOUR_CHAR_CODE("ICON"):
    case FOUR_CHAR_CODE("ICN#"):
    case FOUR_CHAR_CODE("icl4"):
    case FOUR_CHAR_CODE("icl8"):
    case FOUR_CHAR_CODE("ics#"):
    case FOUR_CHAR_CODE("ics4"):
    case FOUR_CHAR_CODE("ics8"): return true;
    default: return false;
    }
}

bool hasPartialAlpha(const QImage& image)
{
    if (!image.hasAlphaChannel())
        return false;
    const QImage argb = image.convertToFormat(QImage::Format_ARGB32);
    for (int y = 0; y < argb.height(); ++y) {
        const auto* row = reinterpret_cast<const QRgb*>(argb.constScanLine(y));
        for (int x = 0; x < argb.width(); ++x)
            if (qAlpha(row[x]) < 255)
                return true;
    }
    return false;
}

bool isAllGrey(const QImage& rgb)
{
    for (int y = 0; y < rgb.height(); ++y) {
        const auto* row = reinterpret_cast<const QRgb*>(rgb.constScanLine(y));
        for (int x = 0; x < rgb.width(); ++x)
            if (!qIsGray(row[x]))
                return false;
    }
    return true;
}

// Stop, note and caution come from the style, never from the resource tree.
AbstractIcon* standardIcon(SInt16 id)
{
    static constexpr QStyle::StandardPixmap kPixmaps[] = {QStyle::SP_MessageBoxCritical,
        QStyle::SP_MessageBoxInformation, QStyle::SP_MessageBoxWarning};
    QImage image;
    if (qobject_cast<QApplication*>(QCoreApplication::instance())) {
        image = QApplication::style()->standardIcon(kPixmaps[id]).pixmap(32, 32).toImage();
        if (!image.isNull() && image.size() != QSize(32, 32))
            image = image.scaled(32, 32, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
        image.setDevicePixelRatio(1.0);
    }
    return new ColorIcon(image, hasPartialAlpha(image), id);
}

// What an icon PNG becomes once its type's mask rule has been applied.
struct DerivedIcon {
    QImage image; // null: the PNG could not be read
    bool monochrome = false;
    bool partialAlpha = false;
};

DerivedIcon deriveIcon(ResType type, const QImage& loaded)
{
    if (loaded.isNull())
        return {};
    if (hasPartialAlpha(loaded))
        return {loaded, false, true};
    QImage image = loaded.convertToFormat(QImage::Format_RGB32);
    bool monochrome = false;
    switch (maskRule(type)) {
    case MaskRule::None: break;
    case MaskRule::White:
        image.setAlphaChannel(image.createMaskFromColor(qRgb(255, 255, 255), Qt::MaskOutColor));
        break;
    case MaskRule::Inverted: {
        monochrome = isAllGrey(image);
        QImage mask = image;
        mask.invertPixels();
        image.setAlphaChannel(mask);
        break;
    }
    }
    return {image, monochrome, false};
}

// Icons a host draws again and again are derived once: by type and ID, never emptied, like
// the PNG cache under it. Missing PNGs are not remembered, so that resources a host
// registers later are found.
const DerivedIcon* derivedIcon(ResType type, SInt16 id)
{
    static auto* sDerived = new QHash<quint64, DerivedIcon>;
    const quint64 key = (quint64(type) << 16) | quint16(id);
    auto it = sDerived->constFind(key);
    if (it != sDerived->constEnd())
        return &it.value();
    const QString path = MakeImageResourceName(type, id);
    if (!resourceFileExists(path))
        return nullptr;
    return &sDerived->insert(key, deriveIcon(type, cachedIconImage(path))).value();
}

} // namespace

QString MakeImageResourceName(ResType type, SInt16 id)
{
    const QString prefix = hasImagePattern(type) ? FourCharToString(type) : QStringLiteral("cicn");
    return QStringLiteral(":/images/%1_%2.png").arg(prefix, QString::number(id));
}

AbstractIcon* LoadIcon(ResType type, SInt16 id)
{
    if (id >= 0 && id <= 2)
        return standardIcon(id);
    const DerivedIcon* icon = derivedIcon(type, id);
    if (!icon || icon->image.isNull())
        return new NullIcon;
    if (icon->monochrome)
        return new MonochromeIcon(icon->image, icon->partialAlpha, id);
    return new ColorIcon(icon->image, icon->partialAlpha, id);
}

} // namespace Velmar
