#include "ryx/headless/form.h"

#include <gtest/gtest.h>

#include "form_fixture.h"
#include "ryx/control.h"
#include "ryx/errors.h"

using namespace ryx;
using namespace ryx::headless;

namespace {

// A small control with two text boxes that follows the shared conventions: it relays the
// boxes' keys first, then Enter and the arrows move the focus. It records what the host
// delivers to it.
class Probe : public Control {
  public:
    explicit Probe(Container& s)
        : Control(s),
          frame_(s.addFrame({.kind = WidgetKind::Frame, .name = "fra", .inFrame = false})),
          first_(s.addTextBox(
              {.kind = WidgetKind::TextBox, .name = "txt", .index = 0, .tabIndex = 1})),
          second_(s.addTextBox(
              {.kind = WidgetKind::TextBox, .name = "txt", .index = 1, .tabIndex = 0})) {
        first_.setHandler([this](Notify n, EventArgs& a) { onBox(0, n, a); });
        second_.setHandler([this](Notify n, EventArgs& a) { onBox(1, n, a); });
    }
    std::string_view typeName() const override { return "Probe"; }
    void InitProperties() override {}
    void ReadProperties(const PropertyBag&) override {}
    void WriteProperties(PropertyBag&) const override {}
    void GotFocus() override {
        log.push_back("GotFocus");
        if (passFocusToFirst) first_.setFocus();
    }
    void ExitFocus() override { log.push_back("ExitFocus"); }

    std::vector<std::string> log;
    bool passFocusToFirst = false;
    std::string injectOnKey;

  private:
    void applyEnabled(bool v) override { frame_.setEnabled(v); }
    void onBox(int index, Notify n, EventArgs& a) {
        relay(n, a, Variant(static_cast<int16_t>(index)));
        if (n == Notify::KeyPress) {
            if (!injectOnKey.empty() && a.KeyAscii == 'x') inject(injectOnKey);
            enterMovesFocus(a.KeyAscii);
        }
        if (n == Notify::KeyDown) arrowMovesFocus(a.KeyCode);
    }
    Frame& frame_;
    TextBox& first_;
    TextBox& second_;
};

class FormTest : public ::testing::Test {
  protected:
    void SetUp() override {
        before = &form.addTextBox("before");
        probe = &form.add<Probe>("probe");
        after = &form.addTextBox("after");
        site = &form.site("probe");
        first = &site->child<HTextBox>("txt", 0);
        second = &site->child<HTextBox>("txt", 1);
    }
    std::string focusedName() const {
        return form.focused() ? form.focused()->displayName() : "(none)";
    }

    Form form;
    HTextBox* before = nullptr;
    HTextBox* after = nullptr;
    Probe* probe = nullptr;
    Site* site = nullptr;
    HTextBox* first = nullptr;
    HTextBox* second = nullptr;
};

TEST_F(FormTest, TabFollowsTheTabIndexesAndWraps) {
    form.setFocus(*before);
    std::vector<std::string> seen;
    for (int i = 0; i < 4; ++i) {
        form.tab();
        seen.push_back(focusedName());
    }
    EXPECT_EQ(seen, (std::vector<std::string>{"txt(1)", "txt(0)", "after", "before"}));
    form.shiftTab();
    EXPECT_EQ(focusedName(), "after");
    form.keys("+{TAB}");
    EXPECT_EQ(focusedName(), "txt(0)");
}

TEST_F(FormTest, TabPassesOverWhatCannotTakeTheFocus) {
    struct Case {
        const char* what;
        std::function<void()> change;
        const char* next;
    } cases[] = {
        {"hidden box", [&] { second->setVisible(false); }, "txt(0)"},
        {"disabled box", [&] { second->setEnabled(false); }, "txt(0)"},
        {"disabled frame", [&] { probe->setEnabled(false); }, "after"},
        {"locked control", [&] { probe->setLocked(true); }, "after"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        second->setVisible(true);
        second->setEnabled(true);
        probe->setEnabled(true);
        probe->setLocked(false);
        c.change();
        form.setFocus(*before);
        form.tab();
        EXPECT_EQ(focusedName(), c.next);
    }
}

TEST_F(FormTest, FocusEnteringAlongTheTabOrderReachesTheControlFirst) {
    form.setFocus(*before);
    form.tab();
    form.tab();
    form.tab();
    EXPECT_EQ(probe->log, (std::vector<std::string>{"GotFocus", "ExitFocus"}));

    probe->log.clear();
    probe->passFocusToFirst = true;
    form.setFocus(*before);
    form.tab();  // the tab order names txt(1); the control passes the focus to txt(0)
    EXPECT_EQ(focusedName(), "txt(0)");
    form.click(*second);  // a click goes straight to the child
    EXPECT_EQ(focusedName(), "txt(1)");
    EXPECT_EQ(probe->log, (std::vector<std::string>{"GotFocus"}));
}

TEST_F(FormTest, InjectedKeysArriveAfterTheKeyBeingHandled) {
    probe->injectOnKey = "yz";
    form.setFocus(*first);
    form.type("axb");
    EXPECT_EQ(first->text(), "axyzb");

    probe->injectOnKey = "{HOME}q";
    first->setText("");
    form.type("x");
    EXPECT_EQ(first->text(), "qx");
}

TEST_F(FormTest, EnterAndArrowsMoveTheFocusByInjectedTabs) {
    form.setFocus(*second);
    form.type("a\r");
    EXPECT_EQ(second->text(), "a");  // the Enter never reaches the box
    EXPECT_EQ(focusedName(), "txt(0)");
    form.press(vk::Down);
    EXPECT_EQ(focusedName(), "after");
    form.press(vk::Up);  // a plain box of the host does nothing with arrows
    EXPECT_EQ(focusedName(), "after");
    form.setFocus(*first);
    form.press(vk::Up);
    EXPECT_EQ(focusedName(), "txt(1)");
}

TEST_F(FormTest, HostHandlersChangeTheKeyBeforeTheControlActs) {
    site->onEvent = [](EventId id, EventArgs& a) {
        if (id == EventId::KeyPress && a.KeyAscii == 'a') a.KeyAscii = 'b';
        if (id == EventId::KeyPress && a.KeyAscii == 13) a.KeyAscii = 0;
        if (id == EventId::KeyDown && a.KeyCode == vk::Down) a.KeyCode = 0;
    };
    form.setFocus(*first);
    form.type("aa\r");
    form.press(vk::Down);
    EXPECT_EQ(first->text(), "bb");
    EXPECT_EQ(focusedName(), "txt(0)");
    const auto& e = form.events().back();
    EXPECT_EQ(e.id, EventId::KeyUp);
    EXPECT_EQ(e.args.Index, Variant(int16_t{0}));
}

TEST_F(FormTest, GivingFocusToAWidgetThatCannotTakeItFailsWithItsName) {
    second->setVisible(false);
    try {
        form.setFocus(*second);
        FAIL() << "no error";
    } catch (const WidgetError& e) {
        EXPECT_NE(std::string(e.what()).find("txt(1)"), std::string::npos);
    }
    EXPECT_THROW(second->setFocus(), WidgetError);
}

TEST_F(FormTest, LockedStopsClicksAndKeysAndTheInsertToggleIsReported) {
    form.setFocus(*first);
    probe->setLocked(true);
    form.type("abc");
    form.click(*second);
    EXPECT_EQ(first->text(), "");
    EXPECT_EQ(focusedName(), "txt(0)");
    EXPECT_TRUE(form.events().empty());
    EXPECT_EQ(form.keyState(vk::Insert), 0);
    form.setInsertToggle(true);
    EXPECT_NE(form.keyState(vk::Insert), 0);
}

TEST_F(FormTest, UpperCaseMapping) {
    struct Case {
        int16_t in, out;
    } cases[] = {{'a', 'A'},   {'z', 'Z'},   {'A', 'A'},    {'1', '1'},     {'-', '-'},
                 {0xE9, 0xC9}, {0xF7, 0xF7}, {0xFF, 0x178}, {0x3B1, 0x391}, {0x451, 0x401}};
    for (const Case& c : cases)
        EXPECT_EQ(form.upperCase(c.in), c.out) << c.in;
}

TEST_F(FormTest, SizeChangesRaiseResizeOnlyWhenTheSizeChanges) {
    site->clearRecords();
    site->setSize(site->width(), site->height());
    EXPECT_EQ(site->resizes(), 0);
    site->setSize(100, 200);
    EXPECT_EQ(site->resizes(), 1);
    EXPECT_EQ(form.create("NoSuchControl", "x"), nullptr);
    EXPECT_THROW(form.add<Probe>("probe"), IndexError);
}

}  // namespace
