// The record: made on the current port's window, its widgets, geometry and flags.
#include <Velmar/AQtWindow.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/HostCore.h>
#include <Velmar/HostShell.h>
#include <Velmar/TextEdit.h>
#include <Velmar/Windows.h>

#include "foundation/Conversions.h"
#include "foundation/Lifetime.h"
#include "quickdraw/CurrentPort.h"
#include "textedit/TEEditorSupport.h"
#include "textedit/TERecordPrivate.h"
#include "windows/WindowFilters.h"

#include <QCoreApplication>
#include <QResizeEvent>

namespace Velmar {

using namespace Private;

namespace Private {

bool checkRecord(const TEPtr* te, const char* file, int line, const char* function)
{
    if (!te) {
        velmar_assert("te != NULL", file, line, function, nullptr);
        return false;
    }
    return checkLive(te, "IsValidTERecord(te)", file, line, function);
}

CommonTextEditAPI* editorOf(const TEPtr* te, const char* call)
{
    CommonTextEditAPI* editor = te->Qt();
    if (!editor)
        VelmarLog(kLogTextEdit, "Velmar::%s: the record's window is gone", call);
    return editor;
}

void registerRecord(TEPtr* te)
{
    LiveHandles<TEPtr>::instance().add(te);
}

void unregisterRecord(TEPtr* te)
{
    LiveHandles<TEPtr>::instance().remove(te);
}

QPoint localToViewport(const TEPtr* te, Point local)
{
    const Rect& view = teData(te)->view;
    return QPoint(local.h - view.left, local.v - view.top);
}

Point viewportToLocal(const TEPtr* te, const QPoint& viewport)
{
    const Rect& view = teData(te)->view;
    return toPoint(viewport.x() + view.left, viewport.y() + view.top);
}

void applyGeometry(TEPtr* te)
{
    TEPtrPrivate* d = teData(te);
    CommonTextEditAPI* editor = te->Qt();
    if (!editor || !te->QtClip())
        return;
    // Local coordinates to the window widget's: less the port's origin.
    const QPoint origin = d->port && IsValidPort(d->port) ? d->port->bounds.topLeft() : QPoint();
    const QRect clip = toQRect(d->clip).translated(-origin);
    const QRect view = toQRect(d->view).translated(-origin);
    te->QtClip()->setGeometry(clip);
    QWidget* widget = editor->widget();
    widget->setGeometry(view.translated(-clip.topLeft()));
    // A hidden widget hears of its size only when shown, but TextEdit lays lines out at
    // once: the scroll area places its viewport, and the viewport's size reaches the editor.
    if (!widget->isVisible()) {
        for (QWidget* w : {widget, editor->viewportWidget()}) {
            QResizeEvent resize(w->size(), QSize());
            QCoreApplication::sendEvent(w, &resize);
        }
    }
    const int destWidth = d->dest.right - d->dest.left;
    editor->setWrapWidth(
        d->noWrap || d->crOnly < 0 ? -1 : (d->pixelWrap || editor->isStyled() ? destWidth : 0));
    editor->setScrollPixels(std::max(0, d->view.top - d->dest.top));
}

void editorGone(TEPtr* te, const QString& text)
{
    if (!isLive(te))
        return;
    teData(te)->orphanText = text;
    te->m_editor = nullptr;
    te->m_clip = nullptr;
}

bool callClickLoop(TEPtr* te)
{
    if (!isLive(te))
        return false;
    TEClickLoopUPP loop = teData(te)->clickLoop;
    if (!loop)
        return true;
    bool goOn = false;
    callGuarded([&] { goOn = loop(te) != 0; }, "A click loop threw");
    return goOn && isLive(te) && te->Qt();
}

QPalette recordPalette(const TEPtr* te, const QPalette& base)
{
    const TEPtrPrivate* d = teData(te);
    QPalette palette = base;
    QColor back = Qt::white, text = Qt::black;
    if (d->port && IsValidPort(d->port)) {
        back = d->port->backColor;
        text = d->port->foreColor();
        if (d->useAccentColor)
            palette.setColor(QPalette::Highlight, d->port->hiliteColor);
    }
    palette.setColor(QPalette::Base, back);
    palette.setColor(QPalette::Window, back);
    palette.setColor(QPalette::Text, text);
    // The host palette's colours, when it has all eight.
    static const char* const kKeys[] = {"HighlightColor", "HighlightedTextColor", "ActiveTEBgColor",
        "ActiveTETextColor", "TEBgColor", "TETextColor", "RowColSelectedActiveColor",
        "AppFontColor"};
    RGBColor skin[8];
    bool haveSkin = true;
    const Palette::PaletteManager* manager = Palette::PaletteManager::Instance();
    for (int i = 0; i < 8; ++i)
        haveSkin = haveSkin && manager
            && manager->GetTxRGBColorBasedOnHighlightIndex(QString::fromLatin1(kKeys[i]), skin[i]);
    if (haveSkin) {
        palette.setBrush(QPalette::All, QPalette::Highlight, toQColor(skin[0]));
        palette.setBrush(QPalette::All, QPalette::HighlightedText, toQColor(skin[1]));
        palette.setColor(QPalette::Active, QPalette::Base, toQColor(skin[2]));
        palette.setColor(QPalette::Active, QPalette::Text, toQColor(skin[3]));
        palette.setColor(QPalette::Inactive, QPalette::Base, toQColor(skin[4]));
        palette.setColor(QPalette::Inactive, QPalette::Text, toQColor(skin[5]));
    }
    for (auto it = d->paletteColours.cbegin(); it != d->paletteColours.cend(); ++it)
        palette.setColor(QPalette::ColorRole(it.key()), it.value());
    if (d->transparentBackground) {
        QColor clear = palette.color(QPalette::Base);
        clear.setAlpha(0);
        palette.setColor(QPalette::Base, clear);
    }
    if (d->alwaysDrawAsActive)
        for (int role = 0; role < QPalette::NColorRoles; ++role)
            palette.setColor(QPalette::Inactive, QPalette::ColorRole(role),
                palette.color(QPalette::Active, QPalette::ColorRole(role)));
    return palette;
}

void applyRecordFont(TEPtr* te)
{
    TEPtrPrivate* d = teData(te);
    if (CommonTextEditAPI* editor = te->Qt())
        editor->widget()->setFont(TxFontSizeFaceToQFont(d->txFont, d->txSize, d->txFace, false));
}

} // namespace Private

namespace {

// Input-method text that reaches a window standing in for a record goes to its editor.
void installTextEditHooks()
{
    static bool sInstalled = false;
    if (sInstalled)
        return;
    sInstalled = true;
    WindowFilterHooks hooks = windowFilterHooks();
    hooks.forwardInputMethod = [](CommonTextEditAPI* editor, QInputMethodEvent* e) {
        editor->teInputMethod(e);
    };
    SetWindowFilterHooks(hooks);
}

} // namespace

TEPtr::TEPtr(const Rect* dest, const Rect* view, bool styled) : m_d(new TEPtrPrivate)
{
    installTextEditHooks();
    registerRecord(this);
    GrafPtr port = currentGrafPort();
    // Without a port the record is still made, with widgets that show nowhere.
    if (VELMAR_ASSERT(port, "port"))
        setInPort(port);
    QWidget* parent = m_d->window;
    m_clip = new QWidget(parent);
    m_clip->setAttribute(Qt::WA_TransparentForMouseEvents);
    if (styled)
        m_editor = new ComplexQTextEdit(this, m_clip);
    else
        m_editor = new SimpleQTextEdit(this, m_clip);
    // The record keeps the font the port draws with.
    if (port) {
        const QFont& font = port->currentFont();
        m_editor->widget()->setFont(font);
        m_d->txFont = GetPortTextFont(port);
        m_d->txSize = port->textSize ? port->textSize : GetTxSizeFromQFont(font);
        m_d->txFace = GetPortTextFace(port);
    }
    const Rect none{0, 0, 0, 0};
    m_d->view = view ? *view : none;
    m_d->dest = dest ? *dest : none;
    m_d->clip = m_d->view;
    applyGeometry(this); // once, with all three in place
    m_editor->fullRepaint();
    if (parent) {
        m_clip->show();
        m_editor->widget()->show();
    }
}

TEPtr::~TEPtr()
{
    Dispose();
    unregisterRecord(this);
    if (m_d->hText)
        TxDisposeHandle(m_d->hText);
    delete m_d;
}

void TEPtr::Dispose()
{
    if (m_editor) {
        if (auto* edit = dynamic_cast<AQTextEdit<QPlainTextEdit>*>(m_editor))
            edit->setOwner(nullptr);
        else if (auto* rich = dynamic_cast<AQTextEdit<QTextEdit>*>(m_editor))
            rich->setOwner(nullptr);
    }
    if (m_d->window)
        if (auto* window = qobject_cast<AQtWindow*>(m_d->window.data());
            window && window->focusProxyTextEdit() == m_editor)
            window->setFocusProxyTextEdit(nullptr);
    // Later, not now: the record may be disposed from inside its own click tracking.
    if (m_clip) {
        m_clip->hide();
        deleteWhenFree(m_clip);
    }
    m_editor = nullptr;
    m_clip = nullptr;
}

// ---- Geometry ----------------------------------------------------------------------------

Rect TEPtr::destRect() const
{
    const Rect& dest = m_d->dest;
    if (!m_editor)
        return dest;
    // Scrolling moves the destination rectangle up against the view.
    const int top = m_d->view.top - m_editor->scrollPixels();
    return Rect{SInt16(top), dest.left, SInt16(top + (dest.bottom - dest.top)), dest.right};
}

void TEPtr::setDestRect(const Rect& rect)
{
    m_d->dest = rect;
    applyGeometry(this);
}

Rect TEPtr::viewRect() const
{
    return m_d->view;
}

void TEPtr::setViewRect(const Rect& rect)
{
    m_d->view = rect;
    applyGeometry(this);
}

void TEPtr::setClipRect(const Rect& rect)
{
    m_d->clip = rect;
    applyGeometry(this);
}

GrafPtr TEPtr::inPort() const
{
    return m_d->port;
}

void TEPtr::setInPort(GrafPtr port)
{
    if (!VELMAR_ASSERT(port, "port")
        || !VELMAR_ASSERT(port->window != nullptr, "port->window != NULL"))
        return;
    m_d->port = port;
    m_d->window = port->window;
    if (m_clip && m_clip->parentWidget() != m_d->window) {
        m_clip->setParent(m_d->window);
        m_clip->show();
        applyGeometry(this);
    }
}

// ---- Font and layout ---------------------------------------------------------------------

SInt16 TEPtr::lineHeight() const
{
    if (m_d->lineHeight > 0 || !m_editor)
        return m_d->lineHeight;
    return SInt16(m_editor->widget()->fontMetrics().lineSpacing());
}

void TEPtr::setLineHeight(SInt16 height)
{
    m_d->lineHeight = height;
}

SInt16 TEPtr::fontAscent() const
{
    if (m_d->fontAscent > 0 || !m_editor)
        return m_d->fontAscent;
    return SInt16(m_editor->widget()->fontMetrics().ascent());
}

void TEPtr::setFontAscent(SInt16 ascent)
{
    m_d->fontAscent = ascent;
}

SInt16 TEPtr::txFont() const
{
    return m_d->txFont;
}

void TEPtr::setTxFont(SInt16 font, bool appFont)
{
    m_d->txFont = appFont
        ? GetTxFontFromQFont(TxFontSizeFaceToQFont(font, m_d->txSize, m_d->txFace, true))
        : font;
    applyRecordFont(this);
}

SInt16 TEPtr::txSize() const
{
    return m_d->txSize;
}

void TEPtr::setTxSize(SInt16 size, bool appFont)
{
    m_d->txSize = appFont
        ? GetTxSizeFromQFont(TxFontSizeFaceToQFont(m_d->txFont, size, m_d->txFace, true))
        : size;
    applyRecordFont(this);
}

Style TEPtr::txFace() const
{
    return m_d->txFace;
}

void TEPtr::setTxFace(Style face, bool)
{
    m_d->txFace = face;
    applyRecordFont(this);
}

SInt16 TEPtr::just() const
{
    return m_d->just;
}

void TEPtr::setJust(SInt16 just)
{
    m_d->just = just;
    if (!m_editor)
        return;
    m_editor->setAlignment(alignmentForJust(just));
}

SInt16 TEPtr::crOnly() const
{
    return m_d->crOnly;
}

// Negative: lines break only at returns.
void TEPtr::setCrOnly(SInt16 crOnly)
{
    m_d->crOnly = crOnly;
    applyGeometry(this);
}

void TEPtr::setUsePixelWrapMode(bool pixelWrap)
{
    m_d->pixelWrap = pixelWrap;
    applyGeometry(this);
}

void TEPtr::SetLineNoWrapMode()
{
    m_d->noWrap = true;
    applyGeometry(this);
}

void TEPtr::setAllowMultipleBlocks(bool allow)
{
    m_d->allowMultipleBlocks = allow;
}

// ---- Appearance and state ----------------------------------------------------------------

bool TEPtr::displayOnly() const
{
    return m_d->displayOnly;
}

void TEPtr::setDisplayOnly(bool displayOnly)
{
    m_d->displayOnly = displayOnly;
    SetReadOnly(displayOnly);
}

void TEPtr::SetReadOnly(bool readOnly)
{
    if (!m_editor)
        return;
    if (auto* plain = qobject_cast<QPlainTextEdit*>(m_editor->widget()))
        plain->setReadOnly(readOnly);
    else if (auto* rich = qobject_cast<QTextEdit*>(m_editor->widget()))
        rich->setReadOnly(readOnly);
}

bool TEPtr::useAccentColor() const
{
    return m_d->useAccentColor;
}

void TEPtr::setUseAccentColor(bool use)
{
    m_d->useAccentColor = use;
    if (m_editor)
        m_editor->fullRepaint();
}

bool TEPtr::useTransparentBackground() const
{
    return m_d->transparentBackground;
}

void TEPtr::setUseTransparentBackground(bool use)
{
    m_d->transparentBackground = use;
    if (m_editor)
        m_editor->fullRepaint();
}

bool TEPtr::alwaysDrawAsActive() const
{
    return m_d->alwaysDrawAsActive;
}

void TEPtr::setAlwaysDrawAsActive(bool always)
{
    m_d->alwaysDrawAsActive = always;
    if (m_editor)
        m_editor->fullRepaint();
}

void TEPtr::maskAllCharacters(unsigned short mask)
{
    if (mask)
        startMasking(this, mask);
    else
        stopMasking(this);
}

void TEPtr::undo()
{
    if (m_editor)
        m_editor->undo();
}

void TEPtr::redo()
{
    if (m_editor)
        m_editor->redo();
}

bool TEPtr::canUndo() const
{
    return m_editor && m_editor->canUndo();
}

bool TEPtr::canRedo() const
{
    return m_editor && m_editor->canRedo();
}

WindowRef TEPtr::GetFocusWindowOnActivate() const
{
    return m_d->focusWindow;
}

void TEPtr::SetFocusWindowOnActivate(WindowRef window)
{
    m_d->focusWindow = window;
}

} // namespace Velmar
