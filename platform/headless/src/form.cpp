#include "ryx/headless/form.h"

#include <algorithm>
#include <ctime>

#include "control_types.h"
#include "ryx/common/missing_record_source.h"
#include "ryx/common/utf8.h"
#include "ryx/errors.h"

namespace ryx::headless {
namespace {

WidgetDesign plainDesign(WidgetKind kind, const std::string& name) {
    return {.kind = kind, .name = name, .backColor = 0x00FFFFFF, .tabIndex = 0, .inFrame = false};
}

}  // namespace

Form::Form() = default;
Form::~Form() = default;

Site& Form::newSite(std::string name, Twips width, Twips height) {
    if (findSite(name)) throw IndexError("the form already holds a control named " + name);
    sites_.push_back(std::make_unique<Site>(*this, std::move(name), width, height));
    order_.push_back({sites_.back().get(), nullptr});
    return *sites_.back();
}

HostedControl* Form::create(std::string_view type, std::string name, Twips width, Twips height) {
    if (!isControlType(type)) return nullptr;
    Site& s = newSite(std::move(name), width, height);
    s.attach(createControl(type, s));
    return &s.control();
}

HTextBox& Form::addTextBox(std::string name) {
    auto box = std::make_unique<HTextBox>(nullptr, plainDesign(WidgetKind::TextBox, name));
    HTextBox& ref = *box;
    plain_.push_back(std::move(box));
    order_.push_back({nullptr, &ref});
    return ref;
}

HCommandButton& Form::addButton(std::string name) {
    auto button =
        std::make_unique<HCommandButton>(nullptr, plainDesign(WidgetKind::CommandButton, name));
    HCommandButton& ref = *button;
    plain_.push_back(std::move(button));
    order_.push_back({nullptr, &ref});
    return ref;
}

Site* Form::findSite(std::string_view name) const {
    for (const auto& s : sites_)
        if (s->name() == name) return s.get();
    return nullptr;
}

Site& Form::site(std::string_view name) const {
    if (Site* s = findSite(name)) return *s;
    throw IndexError("the form holds no control named " + std::string(name));
}

Site& Form::siteOf(const HostedControl& control) const {
    for (const auto& s : sites_)
        if (&s->control() == &control) return *s;
    throw IndexError("the control is not on this form");
}

CivilDate Form::today() const {
    if (fixedToday_) return *fixedToday_;
    std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    return {local.tm_year + 1900, local.tm_mon + 1, local.tm_mday};
}

std::unique_ptr<RecordSource> Form::makeRecordSource(const DataSourceDesign& d) const {
    if (recordSources_) return recordSources_(d);
    return std::make_unique<common::MissingRecordSource>(d);
}

// ---- focus -------------------------------------------------------------------------------

bool Form::inputReaches(const Node& n) const {
    if (n.site()) return n.site()->inputReaches(n);
    return n.isEnabled() && n.isVisible();
}

bool Form::canTakeFocus(const Node& n) const {
    if (n.site() && &n == &n.site()->surface()) return n.site()->surfaceEnabled();
    return n.takesFocus() && n.tabIndex() >= 0 && inputReaches(n);
}

std::vector<Node*> Form::tabStops() const {
    std::vector<Node*> stops;
    for (const Entry& e : order_) {
        if (e.plain) {
            stops.push_back(e.plain);
            continue;
        }
        std::vector<Node*> mine;
        for (const auto& n : e.site->children())
            if (n->takesFocus() && n->tabIndex() >= 0) mine.push_back(n.get());
        std::stable_sort(mine.begin(), mine.end(),
                         [](Node* a, Node* b) { return a->tabIndex() < b->tabIndex(); });
        stops.insert(stops.end(), mine.begin(), mine.end());
    }
    return stops;
}

void Form::moveFocus(Node* target, bool enterControl) {
    Node* old = focused_;
    if (old == target) return;
    Site* oldSite = old ? old->site() : nullptr;
    Site* newSite = target ? target->site() : nullptr;
    focused_ = target;
    if (old) old->notify(Notify::LostFocus);
    if (oldSite && oldSite != newSite) oldSite->control().ExitFocus();
    if (focused_ != target) return;  // a focus-loss handler moved the focus on
    bool toSurface = newSite && target == &newSite->surface();
    if (enterControl && newSite && newSite != oldSite && !toSurface) {
        newSite->control().GotFocus();
        if (focused_ != target) return;  // the control passed the focus to another child
    }
    if (target) target->notify(Notify::GotFocus);
}

void Form::setFocus(Node& target) {
    if (!canTakeFocus(target))
        throw WidgetError(target.displayName() +
                          " cannot take the focus: it is hidden or disabled");
    moveFocus(&target, false);
}

void Form::focusControl(Site& s) {
    if (!s.surfaceEnabled()) return;
    moveFocus(&s.surface(), false);
    deliverInjected();
}

void Form::moveFocusBy(int step) {
    std::vector<Node*> stops = tabStops();
    if (stops.empty()) return;
    const auto count = static_cast<long>(stops.size());
    long at = -1;
    if (focused_) {
        auto it = std::find(stops.begin(), stops.end(), focused_);
        if (it != stops.end()) {
            at = it - stops.begin();
        } else if (Site* s = focused_->site()) {
            // The surface holds the focus: the control's own stops are passed over.
            long first = count, last = -1;
            for (long i = 0; i < count; ++i) {
                if (stops[static_cast<size_t>(i)]->site() == s) {
                    first = std::min(first, i);
                    last = std::max(last, i);
                }
            }
            if (last >= 0) at = step > 0 ? last : first;
        }
    }
    if (at < 0) at = step > 0 ? -1 : count;
    for (long tries = 0; tries < count; ++tries) {
        at = ((at + step) % count + count) % count;
        Node* candidate = stops[static_cast<size_t>(at)];
        if (candidate == focused_) return;
        if (canTakeFocus(*candidate)) {
            moveFocus(candidate, true);
            return;
        }
    }
}

void Form::tab() {
    moveFocusBy(1);
    deliverInjected();
}

void Form::shiftTab() {
    moveFocusBy(-1);
    deliverInjected();
}

// ---- keys --------------------------------------------------------------------------------

void Form::injectKeys(std::string_view keys) {
    for (const common::KeyStroke& k : common::parseKeys(keys))
        injected_.push_back(k);
}

int16_t Form::keyState(int16_t virtualKey) const {
    if (virtualKey == vk::Insert) return insertOn_ ? 1 : 0;
    return 0;
}

int16_t Form::upperCase(int16_t keyChar) const {
    const auto c = static_cast<uint16_t>(keyChar);
    auto up = [](int v) { return static_cast<int16_t>(v); };
    if (c >= 'a' && c <= 'z') return up(c - 32);
    if (c >= 0xE0 && c <= 0xFE && c != 0xF7) return up(c - 32);  // Latin-1 letters
    if (c == 0xFF) return up(0x178);
    if (c >= 0x3B1 && c <= 0x3C9 && c != 0x3C2) return up(c - 32);  // Greek
    if (c >= 0x430 && c <= 0x44F) return up(c - 32);                // Cyrillic
    if (c >= 0x450 && c <= 0x45F) return up(c - 80);
    return keyChar;
}

void Form::deliverKey(const common::KeyStroke& k) {
    const bool alt = (k.shift & shift::Alt) != 0;
    if (k.keyCode == vk::Tab && !alt && !(k.shift & shift::Ctrl)) {
        moveFocusBy((k.shift & shift::Shift) ? -1 : 1);
        return;
    }
    Node* target = focused_;
    if (!target || !inputReaches(*target)) {
        if (alt) routeAccessKey(k.keyCode);
        return;
    }
    EventArgs down;
    down.KeyCode = k.keyCode;
    down.Shift = k.shift;
    target->notify(Notify::KeyDown, down);
    if (down.KeyCode != 0 && inputReaches(*target))
        target->keyDownDefault(down.KeyCode, down.Shift);
    if (alt) {
        routeAccessKey(k.keyCode);
    } else if (k.keyChar != 0) {
        EventArgs press;
        press.KeyAscii = k.keyChar;
        target->notify(Notify::KeyPress, press);
        if (press.KeyAscii != 0 && inputReaches(*target)) target->keyCharDefault(press.KeyAscii);
    }
    EventArgs up;
    up.KeyCode = k.keyCode;
    up.Shift = k.shift;
    target->notify(Notify::KeyUp, up);
}

void Form::routeAccessKey(int16_t keyCode) {
    if (keyCode < 'A' || keyCode > 'Z') return;
    const char upper = static_cast<char>(keyCode);
    const char lower = static_cast<char>(keyCode + 32);
    for (const auto& s : sites_) {
        std::string_view keys = s->control().accessKeys();
        if (keys.find(upper) == std::string_view::npos &&
            keys.find(lower) == std::string_view::npos)
            continue;
        if (!s->surfaceEnabled()) continue;
        int16_t ch = lower;
        s->control().AccessKeyPress(ch);
        return;
    }
}

void Form::deliverInjected() {
    if (delivering_) return;
    delivering_ = true;
    struct Reset {
        bool& flag;
        ~Reset() { flag = false; }
    } reset{delivering_};
    while (!injected_.empty()) {
        common::KeyStroke k = injected_.front();
        injected_.pop_front();
        deliverKey(k);
    }
}

void Form::press(int16_t keyCode, int16_t shift) {
    common::KeyStroke k;
    k.keyCode = keyCode;
    k.shift = shift;
    if (!(shift & (shift::Alt | shift::Ctrl))) {
        if (keyCode == vk::Return || keyCode == vk::Back || keyCode == vk::Escape ||
            keyCode == vk::Space)
            k.keyChar = keyCode;
        else if (keyCode >= '0' && keyCode <= '9')
            k.keyChar = keyCode;
        else if (keyCode >= 'A' && keyCode <= 'Z')
            k.keyChar = static_cast<int16_t>((shift & shift::Shift) ? keyCode : keyCode + 32);
    } else if ((shift & shift::Ctrl) && !(shift & shift::Alt) && keyCode >= 'A' && keyCode <= 'Z') {
        k.keyChar = static_cast<int16_t>(keyCode - 'A' + 1);
    }
    deliverKey(k);
    deliverInjected();
}

void Form::type(std::string_view text) {
    for (char32_t c : common::decodeUtf8(text)) {
        deliverKey(common::strokeForChar(c));
        deliverInjected();
    }
}

void Form::keys(std::string_view notation) {
    for (const common::KeyStroke& k : common::parseKeys(notation)) {
        deliverKey(k);
        deliverInjected();
    }
}

void Form::accessKey(Site& s, int16_t keyChar) {
    if (!s.surfaceEnabled()) return;
    s.control().AccessKeyPress(keyChar);
    deliverInjected();
}

// ---- mouse -------------------------------------------------------------------------------

void Form::mouse(Node& target, Notify what, int16_t button, int16_t shift, float x, float y) {
    if (!inputReaches(target)) return;
    EventArgs args;
    args.Button = button;
    args.Shift = shift;
    args.X = x;
    args.Y = y;
    target.notify(what, args);
    deliverInjected();
}

void Form::mouseDown(Node& target, int16_t button, int16_t shift, float x, float y) {
    mouse(target, Notify::MouseDown, button, shift, x, y);
}

void Form::mouseMove(Node& target, int16_t button, int16_t shift, float x, float y) {
    mouse(target, Notify::MouseMove, button, shift, x, y);
}

void Form::mouseUp(Node& target, int16_t button, int16_t shift, float x, float y) {
    mouse(target, Notify::MouseUp, button, shift, x, y);
}

void Form::click(Node& target) {
    if (!inputReaches(target)) return;
    if (canTakeFocus(target) && target.takesFocus()) moveFocus(&target, false);
    mouse(target, Notify::MouseDown, 1, 0, 0, 0);
    if (inputReaches(target)) target.clickDefault();
    mouse(target, Notify::MouseUp, 1, 0, 0, 0);
    deliverInjected();
}

void Form::doubleClick(Node& target) {
    if (!inputReaches(target)) return;
    mouse(target, Notify::MouseDown, 1, 0, 0, 0);
    target.notify(Notify::DblClick);
    mouse(target, Notify::MouseUp, 1, 0, 0, 0);
    deliverInjected();
}

void Form::clickRow(HListBox& list, int32_t row) {
    if (!inputReaches(list)) return;
    if (canTakeFocus(list)) moveFocus(&list, false);
    mouse(list, Notify::MouseDown, 1, 0, 0, 0);
    list.clickRow(row);
    mouse(list, Notify::MouseUp, 1, 0, 0, 0);
    deliverInjected();
}

}  // namespace ryx::headless
