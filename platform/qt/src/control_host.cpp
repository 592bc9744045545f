#include "ryx/qt/control_host.h"

#include <QApplication>
#include <QDate>
#include <QFocusEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QResizeEvent>
#include <algorithm>
#include <cmath>

#include "qt_widgets.h"
#include "ryx/common/missing_record_source.h"
#include "ryx/errors.h"

namespace ryx::qt {
namespace {

class SystemClock : public Clock {
  public:
    CivilDate today() const override {
        const QDate d = QDate::currentDate();
        return {d.year(), d.month(), d.day()};
    }
};

RecordSourceFactory& recordSourceFactory() {
    static RecordSourceFactory factory;
    return factory;
}

int16_t mouseButtons(Qt::MouseButtons b) {
    int16_t bits = 0;
    if (b & Qt::LeftButton) bits |= 1;
    if (b & Qt::RightButton) bits |= 2;
    if (b & Qt::MiddleButton) bits |= 4;
    return bits;
}

bool isInputEvent(QEvent::Type t) {
    switch (t) {
        case QEvent::KeyPress:
        case QEvent::KeyRelease:
        case QEvent::ShortcutOverride:
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonRelease:
        case QEvent::MouseButtonDblClick:
        case QEvent::MouseMove:
        case QEvent::Wheel:
        case QEvent::ContextMenu:
        case QEvent::InputMethod:
            return true;
        default:
            return false;
    }
}

bool isTab(const QKeyEvent* e) {
    return (e->key() == Qt::Key_Tab || e->key() == Qt::Key_Backtab) &&
           !(e->modifiers() & (Qt::ControlModifier | Qt::AltModifier));
}

}  // namespace

ControlHost::ControlHost(QWidget* parent) : QWidget(parent) {
    setAutoFillBackground(true);
    setFocusPolicy(Qt::NoFocus);
    setRoleColor(this, QPalette::Window, 0x00C0C0FF);
    connect(qApp, &QApplication::focusChanged, this,
            [this](QWidget* old, QWidget* now) { focusChanged(old, now); });
}

ControlHost::~ControlHost() {
    // Focus changes while the widgets go must not reach a host that is half destroyed.
    disconnect(qApp, nullptr, this, nullptr);
    // The control goes first: it may still hold its children.
    control_.reset();
}

void ControlHost::setRecordSourceFactory(RecordSourceFactory factory) {
    recordSourceFactory() = std::move(factory);
}

void ControlHost::setInitialSize(Twips width, Twips height) {
    widthTwips_ = width;
    heightTwips_ = height;
    applyingSize_ = true;
    resize(toPixels(width), toPixels(height));
    applyingSize_ = false;
}

void ControlHost::attachControl(std::unique_ptr<HostedControl> control) {
    control_ = std::move(control);
}

void ControlHost::applyTabOrder() {
    std::vector<QtNode*> stops;
    for (const auto& n : nodes_)
        if (n->takesFocus() && n->tabIndex() >= 0) stops.push_back(n.get());
    std::stable_sort(stops.begin(), stops.end(),
                     [](QtNode* a, QtNode* b) { return a->tabIndex() < b->tabIndex(); });
    for (size_t i = 1; i < stops.size(); ++i)
        QWidget::setTabOrder(stops[i - 1]->widget(), stops[i]->widget());
}

int ControlHost::toPixels(Twips t) const {
    return static_cast<int>(std::lround(t * logicalDpiX() / 1440.0));
}

Twips ControlHost::toTwips(int px) const {
    return static_cast<Twips>(std::round(px * 1440.0 / logicalDpiX()));
}

QSize ControlHost::sizeHint() const {
    return {toPixels(widthTwips_), toPixels(heightTwips_)};
}

// ---- container services ------------------------------------------------------------------

void ControlHost::propertyChanged(std::string_view name) {
    emit propertyChangedNamed(QString::fromUtf8(name.data(), static_cast<int>(name.size())));
}

void ControlHost::setSize(Twips width, Twips height) {
    if (width == widthTwips_ && height == heightTwips_) return;
    setInitialSize(width, height);
    updateGeometry();
    if (control_) control_->Resize();
}

void ControlHost::resizeEvent(QResizeEvent* e) {
    QWidget::resizeEvent(e);
    if (applyingSize_ || !control_) return;
    const Twips w = toTwips(e->size().width()), h = toTwips(e->size().height());
    if (toPixels(widthTwips_) == e->size().width() && toPixels(heightTwips_) == e->size().height())
        return;
    widthTwips_ = w;
    heightTwips_ = h;
    control_->Resize();
}

void ControlHost::setSurfaceEnabled(bool v) {
    surfaceEnabled_ = v;
    updateFocusPolicies();
}

void ControlHost::setSurfaceBackColor(Color c) {
    setRoleColor(this, QPalette::Window, c);
}

const Font& ControlHost::font() const {
    static const Font standard;
    return standard;
}

void ControlHost::repaint() {
    QWidget::repaint();
}

const Clock& ControlHost::clock() const {
    static const SystemClock clock;
    return clock;
}

void ControlHost::raiseEvent(EventId id, EventArgs& args) {
    emit eventRaised(static_cast<int>(id), args);
    switch (id) {
        case EventId::Click:
            emit Click(args);
            break;
        case EventId::DblClick:
            emit DblClick(args);
            break;
        case EventId::Change:
            emit Change(args);
            break;
        case EventId::KeyDown:
            emit KeyDown(args);
            break;
        case EventId::KeyPress:
            emit KeyPress(args);
            break;
        case EventId::KeyUp:
            emit KeyUp(args);
            break;
        case EventId::MouseDown:
            emit MouseDown(args);
            break;
        case EventId::MouseMove:
            emit MouseMove(args);
            break;
        case EventId::MouseUp:
            emit MouseUp(args);
            break;
        case EventId::ButtonClick:
            emit ButtonClick(args);
            break;
    }
}

// ---- building the children ---------------------------------------------------------------

QWidget* ControlHost::parentFor(const WidgetDesign& d) {
    if (d.inFrame && frame_) return frame_;
    return this;
}

template <class W, class... Args>
W& ControlHost::add(const WidgetDesign& d, Args&&... args) {
    auto node = std::make_unique<W>(*this, d, std::forward<Args>(args)...);
    W& ref = *node;
    QWidget* w = ref.widget();
    w->installEventFilter(this);
    if (auto* view = qobject_cast<QAbstractScrollArea*>(w))
        view->viewport()->installEventFilter(this);
    w->setFocusPolicy(ref.focusPolicy());
    w->show();
    nodes_.push_back(std::move(node));
    updateFocusPolicies();
    return ref;
}

Frame& ControlHost::addFrame(const WidgetDesign& d) {
    auto* box = new QtFrameBox(*this, this);
    QtFrame& f = add<QtFrame>(d, box);
    if (!frame_) frame_ = box;
    return f;
}
Label& ControlHost::addLabel(const WidgetDesign& d) {
    return add<QtLabel>(d, parentFor(d));
}
CheckBox& ControlHost::addCheckBox(const WidgetDesign& d) {
    return add<QtCheckBox>(d, parentFor(d));
}
ListBox& ControlHost::addListBox(const WidgetDesign& d) {
    return add<QtListBox>(d, parentFor(d));
}
TextBox& ControlHost::addTextBox(const WidgetDesign& d) {
    return add<QtTextBox>(d, parentFor(d));
}
CommandButton& ControlHost::addCommandButton(const WidgetDesign& d) {
    return add<QtCommandButton>(d, parentFor(d));
}
Image& ControlHost::addImage(const WidgetDesign& d) {
    return add<QtImage>(d, parentFor(d));
}
MaskedEdit& ControlHost::addMaskedEdit(const WidgetDesign& d) {
    return add<QtMaskedEdit>(d, parentFor(d));
}

RecordSource& ControlHost::addRecordSource(const DataSourceDesign& d) {
    if (recordSourceFactory())
        recordSource_ = recordSourceFactory()(d);
    else
        recordSource_ = std::make_unique<common::MissingRecordSource>(d);
    return *recordSource_;
}

QWidget* ControlHost::childWidget(std::string_view name, int16_t index) const {
    for (const auto& n : nodes_)
        if (n->name() == name && n->index() == index) return n->widget();
    return nullptr;
}

QtNode* ControlHost::nodeOf(QObject* o) const {
    for (const auto& n : nodes_) {
        QWidget* w = n->widget();
        if (w == o) return n.get();
        if (auto* view = qobject_cast<QAbstractScrollArea*>(w); view && view->viewport() == o)
            return n.get();
    }
    return nullptr;
}

// ---- input -------------------------------------------------------------------------------

bool ControlHost::inputBlocked(const QtNode& n) const {
    if (!surfaceEnabled_) return true;
    if (n.inFrame() && frame_) {
        for (const auto& f : nodes_)
            if (f->widget() == frame_ && !f->isEnabledFlag()) return true;
    }
    return false;
}

bool ControlHost::canTakeFocus(const QtNode& n) const {
    return n.takesFocus() && n.isEnabledFlag() && n.isVisibleFlag() && !inputBlocked(n);
}

// Locked controls and disabled frames take no focus: Tab passes over them.
void ControlHost::updateFocusPolicies() {
    for (const auto& n : nodes_)
        n->widget()->setFocusPolicy(inputBlocked(*n) ? Qt::NoFocus : n->focusPolicy());
}

void ControlHost::accessKeyPressed(int16_t keyChar) {
    if (!surfaceEnabled_ || !control_) return;
    control_->AccessKeyPress(keyChar);
    QtKeyboard::instance().flush();
}

EventArgs ControlHost::mouseArgs(const QMouseEvent* e) const {
    EventArgs args;
    args.Button = mouseButtons(e->type() == QEvent::MouseMove ? e->buttons() : e->button());
    args.Shift = shiftBitsOf(e->modifiers());
    const QPointF p = e->position();
    args.X = static_cast<float>(p.x() * 1440.0 / logicalDpiX());
    args.Y = static_cast<float>(p.y() * 1440.0 / logicalDpiX());
    return args;
}

bool ControlHost::eventFilter(QObject* watched, QEvent* event) {
    QtNode* n = nodeOf(watched);
    if (!n) return QWidget::eventFilter(watched, event);
    const QEvent::Type type = event->type();
    if (isInputEvent(type) && inputBlocked(*n)) return true;
    switch (type) {
        case QEvent::KeyPress:
            return filterKey(*n, static_cast<QKeyEvent*>(event));
        case QEvent::KeyRelease: {
            auto* e = static_cast<QKeyEvent*>(event);
            if (isTab(e)) return false;
            EventArgs up;
            up.KeyCode = virtualKeyOf(*e);
            up.Shift = shiftBitsOf(e->modifiers());
            n->notify(Notify::KeyUp, up);
            QtKeyboard::instance().flush();
            return true;
        }
        case QEvent::ShortcutOverride:
            return false;
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonRelease:
        case QEvent::MouseButtonDblClick:
        case QEvent::MouseMove:
            return filterMouse(*n, watched, static_cast<QMouseEvent*>(event));
        case QEvent::FocusIn:
            filterFocusIn(*n, static_cast<QFocusEvent*>(event));
            return false;
        case QEvent::FocusOut: {
            const auto reason = static_cast<QFocusEvent*>(event)->reason();
            if (reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason) {
                n->notify(Notify::LostFocus);
                QtKeyboard::instance().flush();
            }
            return false;
        }
        default:
            return false;
    }
}

// A key goes to the control's handler first (KeyDown, then KeyPress with the character the
// key types), then to the widget's own reaction with whatever the handler left; keys that the
// handler injected follow once all of that is done.
bool ControlHost::filterKey(QtNode& n, QKeyEvent* e) {
    if (isTab(e)) return false;
    if (e->key() == Qt::Key_Insert) QtKeyboard::instance().insertPressed();
    EventArgs down;
    down.KeyCode = virtualKeyOf(*e);
    down.Shift = shiftBitsOf(e->modifiers());
    n.notify(Notify::KeyDown, down);
    if (down.KeyCode != 0 && !inputBlocked(n)) n.keyDownDefault(down.KeyCode, down.Shift);
    if (const int16_t ch = keyCharOf(*e)) {
        EventArgs press;
        press.KeyAscii = ch;
        n.notify(Notify::KeyPress, press);
        if (press.KeyAscii != 0 && !inputBlocked(n)) n.keyCharDefault(press.KeyAscii);
    }
    QtKeyboard::instance().flush();
    return true;
}

bool ControlHost::filterMouse(QtNode& n, QObject* watched, QMouseEvent* e) {
    auto* on = static_cast<QWidget*>(watched);
    if (n.qtHandlesMouse()) {
        // A text field places its caret itself; the engine then takes the caret over.
        static_cast<QObject*>(on)->event(e);
        n.afterQtMouse();
    }
    EventArgs args = mouseArgs(e);
    switch (e->type()) {
        case QEvent::MouseButtonPress:
            if (canTakeFocus(n) && QApplication::focusWidget() != n.widget())
                n.widget()->setFocus(Qt::MouseFocusReason);
            mousePressedOn_ = watched;
            n.notify(Notify::MouseDown, args);
            break;
        case QEvent::MouseButtonRelease:
            n.notify(Notify::MouseUp, args);
            if (mousePressedOn_ == watched && e->button() == Qt::LeftButton &&
                on->rect().contains(e->position().toPoint()))
                n.clickDefault(on, e->position().toPoint());
            mousePressedOn_ = nullptr;
            break;
        case QEvent::MouseButtonDblClick:
            n.notify(Notify::DblClick);
            break;
        default:
            n.notify(Notify::MouseMove, args);
            break;
    }
    QtKeyboard::instance().flush();
    return true;
}

void ControlHost::filterFocusIn(QtNode& n, QFocusEvent* e) {
    const bool entering = !focusInside_;
    focusInside_ = true;
    if (entering && control_ &&
        (e->reason() == Qt::TabFocusReason || e->reason() == Qt::BacktabFocusReason)) {
        control_->GotFocus();  // focus entering along the tab order reaches the control first
        if (QApplication::focusWidget() != n.widget()) {
            QtKeyboard::instance().flush();
            return;
        }
    }
    n.notify(Notify::GotFocus);
    QtKeyboard::instance().flush();
}

void ControlHost::focusChanged(QWidget* old, QWidget* now) {
    (void)old;
    if (!focusInside_ || !now) return;  // no widget: the window was left, not the control
    if (now == this || isAncestorOf(now)) return;
    focusInside_ = false;
    if (control_) control_->ExitFocus();
    QtKeyboard::instance().flush();
}

// ---- the surface itself ------------------------------------------------------------------

void ControlHost::surfaceEvent(Notify what, EventArgs& args) {
    if (!surfaceEnabled_ || !control_) return;
    control_->SurfaceEvent(what, args);
    QtKeyboard::instance().flush();
}

void ControlHost::focusInEvent(QFocusEvent* e) {
    QWidget::focusInEvent(e);
    focusInside_ = true;
    if (control_) control_->GotFocus();
    QtKeyboard::instance().flush();
}

void ControlHost::focusOutEvent(QFocusEvent* e) {
    QWidget::focusOutEvent(e);
    if (control_) control_->LostFocus();
}

void ControlHost::keyPressEvent(QKeyEvent* e) {
    if (isTab(e)) return QWidget::keyPressEvent(e);
    EventArgs down;
    down.KeyCode = virtualKeyOf(*e);
    down.Shift = shiftBitsOf(e->modifiers());
    surfaceEvent(Notify::KeyDown, down);
    if (const int16_t ch = keyCharOf(*e)) {
        EventArgs press;
        press.KeyAscii = ch;
        surfaceEvent(Notify::KeyPress, press);
    }
}

void ControlHost::keyReleaseEvent(QKeyEvent* e) {
    if (isTab(e)) return QWidget::keyReleaseEvent(e);
    EventArgs up;
    up.KeyCode = virtualKeyOf(*e);
    up.Shift = shiftBitsOf(e->modifiers());
    surfaceEvent(Notify::KeyUp, up);
}

void ControlHost::mousePressEvent(QMouseEvent* e) {
    EventArgs args = mouseArgs(e);
    surfaceEvent(Notify::MouseDown, args);
}

void ControlHost::mouseMoveEvent(QMouseEvent* e) {
    EventArgs args = mouseArgs(e);
    surfaceEvent(Notify::MouseMove, args);
}

void ControlHost::mouseReleaseEvent(QMouseEvent* e) {
    EventArgs args = mouseArgs(e);
    surfaceEvent(Notify::MouseUp, args);
}

}  // namespace ryx::qt
