// Default host core services: ticks, memory handles, text table, screens, errors, automation.
//
// A host that brings its own core library replaces any of these at run time through the
// Set... call next to each service; the library itself only ever goes through the calls
// below. Every setter returns the previous service and accepts null to restore the default.
// GUI thread only, like the rest of the library.
#pragma once

#include <Velmar/MacTypes.h>

#include <QByteArray>
#include <QPoint>
#include <QRect>
#include <QString>

namespace Velmar {

// ---------------------------------------------------------------------------------------
// Ticks: 60 per second, monotonic, counted from the first call.
using TickSource = UInt32 (*)();
VELMAR_EXPORT UInt32 TxGetTicks();
VELMAR_EXPORT TickSource SetTickSource(TickSource source);

// ---------------------------------------------------------------------------------------
// Whether the application is the one the user works with (default: Qt's application state).
using ForegroundSource = bool (*)();
VELMAR_EXPORT bool isRunningInForeground();
VELMAR_EXPORT ForegroundSource SetForegroundSource(ForegroundSource source);

// ---------------------------------------------------------------------------------------
// Memory handles: a Handle points to the master pointer of a heap block that knows its size.
// Null, unknown and already disposed handles are refused with a log line, never dereferenced.
VELMAR_EXPORT Handle TxPtrToHand(const void* data, Size size); // null data: zero-filled
VELMAR_EXPORT void TxDisposeHandle(Handle handle);
VELMAR_EXPORT Handle TxCopyHand(Handle handle);
VELMAR_EXPORT Size TxGetHandleSize(Handle handle); // -1 for anything not a live handle
VELMAR_EXPORT bool TxIsValidHandle(Handle handle);

// The allocator behind the calls above. Replace it before the first handle is made: each
// allocator only knows its own handles.
class VELMAR_EXPORT HandleAllocator {
public:
    virtual ~HandleAllocator();
    virtual Handle PtrToHand(const void* data, Size size) = 0;
    virtual void DisposeHandle(Handle handle) = 0;
    virtual Handle CopyHand(Handle handle) = 0;
    virtual Size GetHandleSize(Handle handle) = 0;
    virtual bool IsValidHandle(Handle handle) = 0;

    static HandleAllocator* Get();
    static HandleAllocator* SetInstance(HandleAllocator* allocator); // not owned
};

// ---------------------------------------------------------------------------------------
// Localised text table. A key without a translation stands for itself.
class VELMAR_EXPORT TextTable {
public:
    virtual ~TextTable();
    // The text for `key` (taken as UTF-8); the key itself when untranslated, "" for null.
    virtual QString Translate(const char* key) const;
    virtual bool HasTranslation(const char* key) const;

    void Insert(const QString& key, const QString& text);
    void Clear();
    // Loads a JSON object of "key": "text" pairs, merging over what is there.
    // Returns false (and changes nothing) when the file cannot be read or parsed.
    bool LoadJsonFile(const QString& path);

    static TextTable* Get();
    static TextTable* SetInstance(TextTable* table); // not owned

private:
    struct Entries;
    Entries* m_entries = nullptr;
};

// One looked-up text, readable as a C string (UTF-8) for the lifetime of the object.
class VELMAR_EXPORT TxText {
public:
    explicit TxText(const QString& text);
    const char* c_str() const { return m_utf8.constData(); }
    const QString& text() const { return m_text; }

private:
    QString m_text;
    QByteArray m_utf8;
};
VELMAR_EXPORT TxText stx_func(const char* key);

// ---------------------------------------------------------------------------------------
// Screen manager. Screens are numbered from 0 in the order Qt lists them; -1 means none.
class VELMAR_EXPORT AScreenManOS {
public:
    virtual ~AScreenManOS();
    virtual SInt32 GetCurrentScreen() const;            // the primary screen
    virtual SInt32 GetScreenCount() const;
    virtual SInt32 GetScreenForPoint(const QPoint& globalPoint) const; // nearest screen
    virtual SInt16 GetMenuBarHeight(SInt32 screen) const;
    virtual QRect GetScreenRect(SInt32 screen) const;
    virtual QRect GetUsableRect(SInt32 screen) const;  // less task bars and docks
    QRect GetUsableRectForPoint(const QPoint& globalPoint) const;

    static AScreenManOS* Get();
    static AScreenManOS* SetInstance(AScreenManOS* manager); // not owned
};

// ---------------------------------------------------------------------------------------
// The host's exception class. Deliberately not a std::exception: handlers catch it first.
class VELMAR_EXPORT XError {
public:
    XError(const char* type, const char* message, SInt32 line = 0, const char* file = nullptr);
    XError(const XError& other) = default;
    XError& operator=(const XError& other) = default;
    virtual ~XError();
    // First virtual after the destructor: keep it so. (Not "GetMessage": <windows.h> renames that.)
    virtual const char* GetErrorMessage() const;
    virtual const char* GetType() const;
    SInt32 GetLine() const { return m_line; }
    const char* GetFile() const { return m_file.constData(); }

private:
    QByteArray m_type;
    QByteArray m_message;
    SInt32 m_line;
    QByteArray m_file;
};

// The core library's exception log. Default: one critical Qt message
// "XError (type):    Error: <message> Line: <line> File: <file>".
using XErrorLogger = void (*)(const XError& error);
VELMAR_EXPORT void LogXError(const XError& error);
VELMAR_EXPORT XErrorLogger SetXErrorLogger(XErrorLogger logger);

// ---------------------------------------------------------------------------------------
// Automation: a test harness or script host answers dialogs instead of a user.
class VELMAR_EXPORT AutomationListener {
public:
    virtual ~AutomationListener();
    // `choices` are the button labels joined by '|' ("Abort|Retry|Ignore|Ignore All").
    // Returns the chosen label, or its 0-based index as decimal text.
    virtual QString AnswerDialog(const QString& title, const QString& text,
                                 const QString& choices) = 0;
};

class VELMAR_EXPORT AutomationListenerManager {
public:
    static AutomationListener* GetListener(); // null unless one is installed
    static AutomationListener* SetListener(AutomationListener* listener); // not owned
};

// Asks the installed listener and returns the 0-based index of its answer among `choices`
// (labels compared case-insensitively); -1 without a listener or for an unknown answer.
VELMAR_EXPORT SInt32 AskAutomationListener(const QString& title, const QString& text,
                                           const QString& choices);

} // namespace Velmar
