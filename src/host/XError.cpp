// The host's exception class and its log.
#include <Velmar/HostCore.h>

#include "host/Replaceable.h"

#include <QtGlobal>

namespace Velmar {

namespace {

void defaultXErrorLogger(const XError& error)
{
    qCritical("XError (%s):    Error: %s Line: %d File: %s", error.GetType(), error.GetErrorMessage(),
              int(error.GetLine()), error.GetFile());
}

Private::Replaceable<XErrorLogger> gLogger(defaultXErrorLogger);

} // namespace

XError::XError(const char* type, const char* message, SInt32 line, const char* file)
    : m_type(type ? type : ""), m_message(message ? message : ""), m_line(line),
      m_file(file ? file : "")
{
}

XError::~XError() = default;

const char* XError::GetErrorMessage() const
{
    return m_message.constData();
}

const char* XError::GetType() const
{
    return m_type.constData();
}

void LogXError(const XError& error)
{
    gLogger.get()(error);
}

XErrorLogger SetXErrorLogger(XErrorLogger logger)
{
    return gLogger.set(logger);
}

} // namespace Velmar
