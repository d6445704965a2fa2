// The editor widgets: a QPlainTextEdit or QTextEdit that takes its input from TEKey and
// TEClick, never directly from the user.
#include <Velmar/Diagnostics.h>
#include <Velmar/TextEdit.h>

#include "textedit/TEEditorSupport.h"
#include "textedit/TERecordPrivate.h"

#include <QApplication>
#include <QDateTime>
#include <QEventLoop>
#include <QKeyEvent>
#include <QPointer>
#include <QScrollBar>
#include <QTimer>

namespace Velmar {

using namespace Private;

CommonTextEditAPI::~CommonTextEditAPI() = default;

namespace {

// Tracks the mouse for TEClick until the button goes up (or the click loop says stop).
class ClickTracker : public QObject {
public:
    ClickTracker(QWidget* viewport, std::function<void(const QPoint&)> extendTo,
        std::function<bool()> clickLoop)
        : m_viewport(viewport), m_extendTo(std::move(extendTo)), m_clickLoop(std::move(clickLoop))
    {}

    void run(QEventLoop& loop)
    {
        m_loop = &loop;
        qApp->installEventFilter(this);
        QTimer tick;
        QObject::connect(&tick, &QTimer::timeout, [this] { step(); });
        tick.start(16);
        if (QGuiApplication::mouseButtons() == Qt::NoButton)
            QTimer::singleShot(0, &loop, [&loop] { loop.quit(); });
        loop.exec();
        qApp->removeEventFilter(this);
    }

protected:
    bool eventFilter(QObject*, QEvent* event) override
    {
        if (event->type() == QEvent::MouseMove) {
            follow();
        } else if (event->type() == QEvent::MouseButtonRelease) {
            follow();
            m_loop->quit();
        }
        return false;
    }

private:
    void follow()
    {
        if (m_viewport)
            m_extendTo(m_viewport->mapFromGlobal(QCursor::pos()));
    }
    void step()
    {
        follow();
        if (!m_clickLoop() || QGuiApplication::mouseButtons() == Qt::NoButton)
            m_loop->quit();
    }

    QPointer<QWidget> m_viewport;
    std::function<void(const QPoint&)> m_extendTo;
    std::function<bool()> m_clickLoop;
    QEventLoop* m_loop = nullptr;
};

// Selects what the click count asks for around `cursor`: the word (2) or the line (3).
void selectUnit(QTextCursor& cursor, int clicks)
{
    if (clicks == 2) {
        cursor.select(QTextCursor::WordUnderCursor);
    } else if (clicks >= 3) {
        cursor.movePosition(QTextCursor::StartOfBlock);
        cursor.movePosition(QTextCursor::EndOfBlock, QTextCursor::KeepAnchor);
    }
}

} // namespace

template <class Base>
AQTextEdit<Base>::AQTextEdit(TEPtr* owner, QWidget* parent) : Base(parent), m_owner(owner)
{
    // Input reaches the editor through TEKey and TEClick only; the window makes events of
    // the user's keys and clicks.
    this->setAttribute(Qt::WA_TransparentForMouseEvents);
    this->setFrameShape(QFrame::NoFrame);
    this->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    this->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    this->setFocusPolicy(Qt::ClickFocus);
    this->document()->setDocumentMargin(0);
    this->setContextMenuPolicy(Qt::NoContextMenu);
}

template <class Base> AQTextEdit<Base>::~AQTextEdit()
{
    // The widget goes with its window: the record keeps the text.
    if (m_owner)
        editorGone(m_owner, this->document()->toPlainText());
}

template <class Base> bool AQTextEdit<Base>::isStyled() const
{
    return std::is_same_v<Base, QTextEdit>;
}

template <class Base> int AQTextEdit<Base>::scrollPixels() const
{
    const int value = this->verticalScrollBar()->value();
    // A plain editor scrolls by lines, a rich one by pixels.
    if constexpr (std::is_same_v<Base, QPlainTextEdit>)
        return value * this->fontMetrics().lineSpacing();
    return value;
}

template <class Base> void AQTextEdit<Base>::setScrollPixels(int pixels)
{
    int value = pixels;
    if constexpr (std::is_same_v<Base, QPlainTextEdit>)
        value = pixels / std::max(1, this->fontMetrics().lineSpacing());
    this->verticalScrollBar()->setValue(value);
}

template <class Base> void AQTextEdit<Base>::setWrapWidth(int width)
{
    if (width < 0) {
        this->setLineWrapMode(Base::NoWrap);
        return;
    }
    if constexpr (std::is_same_v<Base, QTextEdit>) {
        if (width > 0) {
            this->setLineWrapMode(QTextEdit::FixedPixelWidth);
            this->setLineWrapColumnOrWidth(width);
            return;
        }
    }
    this->setLineWrapMode(Base::WidgetWidth);
}

template <class Base> void AQTextEdit<Base>::setAlignment(Qt::Alignment alignment)
{
    QTextOption option = this->document()->defaultTextOption();
    option.setAlignment(alignment);
    this->document()->setDefaultTextOption(option);
    if constexpr (std::is_same_v<Base, QTextEdit>) {
        QTextCursor all(this->document());
        all.select(QTextCursor::Document);
        QTextBlockFormat format;
        format.setAlignment(alignment);
        all.mergeBlockFormat(format);
    }
}

template <class Base> void AQTextEdit<Base>::teKey(QKeyEvent* event)
{
    Base::keyPressEvent(event);
}

template <class Base> void AQTextEdit<Base>::teClick(const QPoint& point, unsigned char extend)
{
    if (!VELMAR_ASSERT(m_localLoop == nullptr, "m_localLoop == NULL"))
        return;
    // Two clicks close in time and place make a double click, three a triple click.
    const qint64 now = QDateTime::currentMSecsSinceEpoch();
    const bool again = m_lastClickMs >= 0
        && now - m_lastClickMs <= QApplication::doubleClickInterval()
        && (point - m_lastClickPoint).manhattanLength() <= QApplication::startDragDistance();
    m_clickCount = again ? std::min(m_clickCount + 1, 3) : 1;
    m_lastClickMs = now;
    m_lastClickPoint = point;

    // The selection grows from a fixed part: the old anchor when extending, otherwise the
    // character, word or line clicked.
    QTextCursor cursor = this->textCursor();
    const QTextCursor hit = this->cursorForPosition(point);
    int fixedStart = cursor.anchor();
    int fixedEnd = cursor.anchor();
    const int clicks = extend ? 1 : m_clickCount;
    if (extend) {
        cursor.setPosition(hit.position(), QTextCursor::KeepAnchor);
    } else {
        cursor = hit;
        selectUnit(cursor, clicks);
        fixedStart = std::min(cursor.anchor(), cursor.position());
        fixedEnd = std::max(cursor.anchor(), cursor.position());
    }
    this->setTextCursor(cursor);

    QPointer<QWidget> self(this);
    TEPtr* owner = m_owner;
    auto extendTo = [this, fixedStart, fixedEnd, clicks](const QPoint& at) {
        QTextCursor unit = this->cursorForPosition(at);
        selectUnit(unit, clicks);
        const int unitStart = std::min(unit.anchor(), unit.position());
        const int unitEnd = std::max(unit.anchor(), unit.position());
        QTextCursor selection = this->textCursor();
        if (unitStart < fixedStart) {
            selection.setPosition(fixedEnd);
            selection.setPosition(unitStart, QTextCursor::KeepAnchor);
        } else {
            selection.setPosition(fixedStart);
            selection.setPosition(std::max(unitEnd, fixedEnd), QTextCursor::KeepAnchor);
        }
        this->setTextCursor(selection);
    };
    // The host's click loop may dispose of the record, or of its window: tracking ends then.
    auto clickLoop = [self, owner]() { return self && callClickLoop(owner); };
    QEventLoop loop;
    m_localLoop = &loop;
    ClickTracker(this->viewport(), extendTo, clickLoop).run(loop);
    if (self)
        m_localLoop = nullptr;
}

template <class Base> void AQTextEdit<Base>::teUpdate(const QRect& viewportRect)
{
    this->viewport()->update(viewportRect);
}

template <class Base> void AQTextEdit<Base>::teInputMethod(QInputMethodEvent* event)
{
    Base::inputMethodEvent(event);
}

template <class Base> void AQTextEdit<Base>::fullRepaint()
{
    if (m_inRepaint || !this->rect().isValid())
        return;
    if (this->window() && this->window()->testAttribute(Qt::WA_PendingResizeEvent))
        VelmarLog(
            kLogTextEdit, "AQtTextEdit::fullRepaint: QResizeEvent is pending for parent window.");
    m_inRepaint = true;
    if (m_owner)
        this->setPalette(recordPalette(m_owner, this->palette()));
    this->viewport()->setAutoFillBackground(!m_owner || !teData(m_owner)->transparentBackground);
    this->viewport()->update();
    m_inRepaint = false;
}

template <class Base> void AQTextEdit<Base>::keyPressEvent(QKeyEvent* event)
{
    // Copy and paste go to the widget itself; every other key goes on to the window, which
    // makes a key-down event of it for the host.
    const bool control = event->modifiers() & Qt::ControlModifier;
    if (control && (event->key() == Qt::Key_C || event->key() == Qt::Key_V)) {
        Base::keyPressEvent(event);
        return;
    }
    event->ignore();
}

template <class Base> void AQTextEdit<Base>::keyReleaseEvent(QKeyEvent* event)
{
    event->ignore();
}

template <class Base> bool AQTextEdit<Base>::event(QEvent* event)
{
    // Tab and Backtab are keys for the host, not focus moves.
    if (event->type() == QEvent::KeyPress) {
        keyPressEvent(static_cast<QKeyEvent*>(event));
        return event->isAccepted();
    }
    return Base::event(event);
}

template class AQTextEdit<QPlainTextEdit>;
template class AQTextEdit<QTextEdit>;

} // namespace Velmar
