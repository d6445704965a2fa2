// Named look-and-feel values; empty until the host fills or replaces the palette.
#include <Velmar/HostShell.h>

#include "host/Replaceable.h"

#include <QHash>
#include <QVariant>

namespace Velmar::Palette {

struct PaletteManager::Values {
    QHash<QString, QVariant> byKey;
};

PaletteManager::PaletteManager() : m_values(new Values) {}

PaletteManager::~PaletteManager()
{
    delete m_values;
}

bool PaletteManager::GetTxRGBColorBasedOnHighlightIndex(const QString& key, RGBColor& color) const
{
    const QVariant v = m_values->byKey.value(key);
    if (v.typeId() != QMetaType::ULongLong)
        return false;
    const quint64 packed = v.toULongLong();
    color = RGBColor((unsigned short)(packed >> 32), (unsigned short)(packed >> 16),
                     (unsigned short)packed);
    return true;
}

bool PaletteManager::GetUint16(const QString& key, UInt16& value) const
{
    const QVariant v = m_values->byKey.value(key);
    if (v.typeId() != QMetaType::Int || v.toInt() < 0 || v.toInt() > 0xFFFF)
        return false;
    value = UInt16(v.toInt());
    return true;
}

bool PaletteManager::GetSInt32(const QString& key, SInt32& value) const
{
    const QVariant v = m_values->byKey.value(key);
    if (v.typeId() != QMetaType::Int)
        return false;
    value = SInt32(v.toInt());
    return true;
}

bool PaletteManager::GetString(const QString& key, QString& value) const
{
    const QVariant v = m_values->byKey.value(key);
    if (v.typeId() != QMetaType::QString)
        return false;
    value = v.toString();
    return true;
}

// Colours are packed into one 48-bit number so that they keep a type of their own.
void PaletteManager::SetColor(const QString& key, const RGBColor& color)
{
    const quint64 packed = (quint64(color.red) << 32) | (quint64(color.green) << 16) | color.blue;
    m_values->byKey.insert(key, QVariant::fromValue<qulonglong>(packed));
}

void PaletteManager::SetUint16(const QString& key, UInt16 value)
{
    m_values->byKey.insert(key, QVariant(int(value)));
}

void PaletteManager::SetSInt32(const QString& key, SInt32 value)
{
    m_values->byKey.insert(key, QVariant(int(value)));
}

void PaletteManager::SetString(const QString& key, const QString& value)
{
    m_values->byKey.insert(key, QVariant(value));
}

void PaletteManager::Remove(const QString& key)
{
    m_values->byKey.remove(key);
}

void PaletteManager::Clear()
{
    m_values->byKey.clear();
}

PaletteManager* PaletteManager::Instance()
{
    return Private::replaceableInstance<PaletteManager>().get();
}

PaletteManager* PaletteManager::SetInstance(PaletteManager* manager)
{
    return Private::replaceableInstance<PaletteManager>().set(manager);
}

} // namespace Velmar::Palette
