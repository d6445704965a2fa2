// The localised text table: untranslated keys stand for themselves.
#include <Velmar/HostCore.h>

#include "host/Replaceable.h"

#include <QtGlobal>

#include <QFile>
#include <QHash>
#include <QJsonDocument>
#include <QJsonObject>

namespace Velmar {

struct TextTable::Entries {
    QHash<QString, QString> texts;
};

TextTable::~TextTable()
{
    delete m_entries;
}

QString TextTable::Translate(const char* key) const
{
    if (!key)
        return QString();
    const QString k = QString::fromUtf8(key);
    if (m_entries) {
        const auto it = m_entries->texts.constFind(k);
        if (it != m_entries->texts.constEnd())
            return it.value();
    }
    return k;
}

bool TextTable::HasTranslation(const char* key) const
{
    return key && m_entries && m_entries->texts.contains(QString::fromUtf8(key));
}

void TextTable::Insert(const QString& key, const QString& text)
{
    if (!m_entries)
        m_entries = new Entries;
    m_entries->texts.insert(key, text);
}

void TextTable::Clear()
{
    if (m_entries)
        m_entries->texts.clear();
}

bool TextTable::LoadJsonFile(const QString& path)
{
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        qWarning("TextTable: cannot open %s", qPrintable(path));
        return false;
    }
    QJsonParseError error;
    const QJsonDocument document = QJsonDocument::fromJson(file.readAll(), &error);
    if (error.error != QJsonParseError::NoError || !document.isObject()) {
        qWarning("TextTable: %s is not a JSON object of texts", qPrintable(path));
        return false;
    }
    const QJsonObject object = document.object();
    for (auto it = object.begin(); it != object.end(); ++it) {
        if (it.value().isString())
            Insert(it.key(), it.value().toString());
    }
    return true;
}

TextTable* TextTable::Get()
{
    return Private::replaceableInstance<TextTable>().get();
}

TextTable* TextTable::SetInstance(TextTable* table)
{
    return Private::replaceableInstance<TextTable>().set(table);
}

TxText::TxText(const QString& text) : m_text(text), m_utf8(text.toUtf8()) {}

TxText stx_func(const char* key)
{
    return TxText(TextTable::Get()->Translate(key));
}

} // namespace Velmar
