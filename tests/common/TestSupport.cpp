#include "TestSupport.h"

#include <Velmar/Diagnostics.h>

#include "foundation/MessageHandler.h"

#include <QSettings>

namespace VelmarTest {

LogCapture::LogCapture()
{
    // QtTest installs its own message handler while it runs; put the library's back so that
    // every qDebug/qWarning of the code under test becomes a formatted line here.
    m_previousHandler = Velmar::Private::installMessageHandler();
    Velmar::SetDebugOutputHook(&LogCapture::hook, this);
}

LogCapture::~LogCapture()
{
    Velmar::SetDebugOutputHook(nullptr, nullptr);
    qInstallMessageHandler(m_previousHandler);
}

void LogCapture::hook(const char* line, void* context)
{
    static_cast<LogCapture*>(context)->m_lines.append(QString::fromLocal8Bit(line));
}

bool LogCapture::contains(const QString& fragment) const
{
    return count(fragment) > 0;
}

int LogCapture::count(const QString& fragment) const
{
    int n = 0;
    for (const QString& l : m_lines)
        n += l.contains(fragment) ? 1 : 0;
    return n;
}

void isolateSettings()
{
    static QTemporaryDir dir;
    qputenv("XDG_CONFIG_HOME", dir.path().toLocal8Bit());
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.path());
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir.path());
}

} // namespace VelmarTest
