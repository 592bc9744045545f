// The range selector's ControlType, TextType, MaxLength, selection and range texts set to odd
// values, and arbitrary key characters typed into its boxes, with these checked at each step:
// - a typed character reaches a box only as the key filter lets it through (digits and the
//   blank; upper case without punctuation; anything), Enter never, and never past the maximum
//   length; with the Insert toggle on it replaces the character after the caret;
// - a setter either takes its value as documented or fails with the library's own error for a
//   value it cannot take, and leaves both boxes with one maximum length;
// - an end text is only taken when it does not lie below the start.
#include <fuzzer/FuzzedDataProvider.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "ryx/common/utf8.h"
#include "ryx/errors.h"
#include "ryx/headless/form.h"
#include "ryx/range_selector.h"

namespace {

using namespace ryx;
using namespace ryx::headless;

[[noreturn]] void finding(const std::string& what) {
    std::string shown;
    for (char c : what)
        shown += c == '\0' ? std::string("\\0") : std::string(1, c);
    std::fprintf(stderr, "range selector: %s\n", shown.c_str());
    std::abort();
}

#define CHECK(ok, what)           \
    do {                          \
        if (!(ok)) finding(what); \
    } while (0)

constexpr std::u32string_view kDigitKeys = U"123456 7890";

bool isPunctuation(char32_t c) {
    return (c >= 33 && c <= 47) || (c >= 58 && c <= 64) || (c >= 91 && c <= 96) ||
           (c >= 123 && c <= 126);
}

std::string lower(std::string_view s) {
    std::string l(s);
    for (char& c : l)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c + 32);
    return l;
}

Variant oddVariant(FuzzedDataProvider& in) {
    static const char* kTexts[] = {"",    "0",   "1",    "12",         " 12 ",       "2.5",  "3.5",
                                   "-1",  "1e9", "1e10", "&H7FFFFFFF", "&HFFFFFFFF", "&O17", "abc",
                                   "1D2", "+4",  "1,5",  "True",       "&H",         "."};
    switch (in.ConsumeIntegralInRange(0, 6)) {
        case 0:
            return Variant();
        case 1:
            return Variant(in.ConsumeBool());
        case 2:
            return Variant(in.ConsumeIntegralInRange<int16_t>(-3, 40));
        case 3:
            return Variant(in.ConsumeIntegral<int32_t>());
        case 4:
            return Variant(in.ConsumeBool()
                               ? static_cast<double>(in.ConsumeIntegralInRange(-5, 60)) / 2
                               : in.ConsumeFloatingPoint<double>());
        case 5:
            return Variant(in.PickValueInArray(kTexts));
        default:
            return Variant(in.ConsumeRandomLengthString(10));
    }
}

// A key character: mostly letters, digits, punctuation and keys of their own (Enter,
// Backspace, Ctrl+X), sometimes any 16-bit character.
char32_t anyKeyChar(FuzzedDataProvider& in) {
    static constexpr std::u32string_view kChars = U"aZ09 5-&/._'\"~\r\b\x18\x7f\xe9\xff\x3b1\x430";
    if (in.ConsumeBool()) return kChars[in.ConsumeIntegralInRange<size_t>(0, kChars.size() - 1)];
    const char32_t c = in.ConsumeIntegralInRange<char32_t>(1, 0xFFFF);
    return c >= 0xD800 && c <= 0xDFFF ? U'x' : c;  // half a surrogate pair is no character
}

// A text as a host passes one: UTF-8, any bytes that are not being read as U+FFFD.
std::string anyText(FuzzedDataProvider& in, size_t most) {
    return common::encodeUtf8(common::decodeUtf8(in.ConsumeRandomLengthString(most)));
}

class Bench {
  public:
    Bench() {
        form.addTextBox("txtBefore");
        range = &form.add<RYXRangeSelector>("range");
        form.addButton("cmdAfter");
        site = &form.site("range");
        boxes[0] = &site->child<HTextBox>("RYXT", 0);
        boxes[1] = &site->child<HTextBox>("RYXT", 1);
        site->onEvent = [this](EventId id, EventArgs& a) {
            if (id == EventId::KeyPress && changeKey) a.KeyAscii = hostKey;
        };
    }

    void step(FuzzedDataProvider& in) {
        switch (in.ConsumeIntegralInRange(0, 12)) {
            case 0:
                return controlType(in);
            case 1:
                return textType(static_cast<RYXRgSelTxtType>(in.ConsumeBool()
                                                                 ? in.ConsumeIntegralInRange(-1, 3)
                                                                 : in.ConsumeIntegral<int32_t>()));
            case 2:
                return maxLength(oddVariant(in));
            case 3:
            case 4:
            case 5:
                return typeKey(anyKeyChar(in));
            case 6: {
                static const int16_t kCodes[] = {vk::Home,   vk::End,  vk::Left, vk::Right,
                                                 vk::Delete, vk::Back, vk::Up,   vk::Down,
                                                 vk::Return, 'P'};
                return form.press(in.PickValueInArray(kCodes),
                                  in.ConsumeIntegralInRange<int16_t>(0, 7));
            }
            case 7:
                return form.setInsertToggle(in.ConsumeBool());
            case 8:
                return selection(in);
            case 9:
                return in.ConsumeBool() ? startText(anyText(in, 12)) : endText(anyText(in, 12));
            case 10: {
                const int which = in.ConsumeIntegralInRange(0, 3);
                if (which < 2) return form.click(*boxes[which]);
                return which == 2 ? form.tab() : form.shiftTab();
            }
            case 11:
                return in.ConsumeBool() ? range->setEnabled(in.ConsumeBool())
                                        : range->setLocked(in.ConsumeBool());
            default:
                changeKey = in.ConsumeBool();
                hostKey = in.ConsumeIntegral<int16_t>();
                return;
        }
    }

    void checkAlways() {
        CHECK(boxes[0]->maxLength() >= 0 && boxes[0]->maxLength() == boxes[1]->maxLength(),
              "the boxes differ in maximum length");
        for (HTextBox* box : boxes) {
            const auto length = static_cast<int32_t>(common::decodeUtf8(box->text()).size());
            CHECK(box->selStart() >= 0 && box->selLength() >= 0 &&
                      box->selStart() + box->selLength() <= length,
                  "a selection lies outside its text");
        }
        form.clearEvents();
        site->clearRecords();
    }

  private:
    void controlType(FuzzedDataProvider& in) {
        static const char* kTypes[] = {"policyno",  "PolicyNo", "POLICYNO",     "phsdept",
                                       "name",      "pincode",  "plan",         "date",
                                       "Date",      "branchno", "receiptnonsc", "applicationnoulip",
                                       " policyno", ""};
        const std::string T = in.ConsumeBool() ? in.PickValueInArray(kTypes) : anyText(in, 20);
        range->setControlType(T);
        CHECK(range->ControlType() == T, "ControlType not kept as given");
        CHECK(range->StartText().empty() && range->EndText().empty(),
              "ControlType left text in the boxes");
        CHECK(boxes[0]->isVisible() == (T != "date"), "the boxes do not follow the date layout");
    }

    void textType(RYXRgSelTxtType v) {
        range->setTextType(v);
        CHECK(range->TextType() == v, "TextType does not read back");
    }

    void maxLength(const Variant& v) {
        const Variant before = range->MaxLength();
        try {
            range->setMaxLength(v);
        } catch (const OverflowError&) {
            CHECK(range->MaxLength() == before, "a refused MaxLength changed the boxes");
            return;
        }
        if (!v.isNumeric()) {
            CHECK(range->MaxLength() == before, "MaxLength took " + v.describe());
            return;
        }
        const double r = std::nearbyint(v.toDouble());  // halves to even
        CHECK(range->MaxLength() == Variant(static_cast<int32_t>(r)),
              "MaxLength " + v.describe() + " read back as " + range->MaxLength().describe());
    }

    void selection(FuzzedDataProvider& in) {
        const Variant index = oddVariant(in), value = oddVariant(in);
        const bool start = in.ConsumeBool();
        try {
            start ? range->setSelStart(index, value) : range->setSellength(index, value);
            (void)(start ? range->SelStart(index) : range->Sellength(index));
        } catch (const IndexError&) {
        } catch (const OverflowError&) {
        } catch (const TypeMismatchError&) {
            CHECK(!index.isNumeric() || !value.isNumeric(), "a number read as no number");
        }
    }

    void startText(const std::string& V) {
        range->setStartText(V);  // never fails
        CHECK(range->StartText() == V, "StartText not taken");
    }

    void endText(const std::string& V) {
        const std::string S = range->StartText(), before = range->EndText();
        range->setEndText(V);
        const std::string E = range->EndText();
        CHECK(E == V || E == before, "EndText neither taken nor left");
        if (E != V || E == before || V.empty() || S.empty()) return;  // not taken, or unknown
        const std::string kind = lower(range->ControlType());
        const bool numbers = kind == "policyno" || kind == "plan";
        CHECK(numbers ? leadingNumber(V) >= leadingNumber(S) : S <= V,
              "end \"" + V + "\" taken below start \"" + S + "\" for control type \"" +
                  range->ControlType() + "\"");
    }

    // One character typed on the focused widget; in a range box, what the box took.
    void typeKey(char32_t c) {
        Node* focused = form.focused();
        HTextBox* box = focused == boxes[0] ? boxes[0] : focused == boxes[1] ? boxes[1] : nullptr;
        if (!box || !site->inputReaches(*box) || changeKey) {
            form.type(common::encodeUtf8(c));
            return;
        }
        const std::u32string before = common::decodeUtf8(box->text());
        const int32_t selLength = box->selLength(), selStart = box->selStart();
        const bool insertOn = form.keyState(vk::Insert) != 0;
        const int32_t type = range->TextType();
        const int32_t limit = box->maxLength();
        form.type(common::encodeUtf8(c));
        if (form.focused() != box) return;  // Enter moved on
        const std::u32string after = common::decodeUtf8(box->text());
        if (after == before) return;

        const auto s = static_cast<size_t>(selStart);
        auto replaced = [&](size_t length, std::u32string_view with) {
            return before.substr(0, s) + std::u32string(with) +
                   before.substr(std::min(s + length, before.size()));
        };
        const std::string what = "typing U+" + std::to_string(static_cast<uint32_t>(c)) +
                                 " with text type " + std::to_string(type);
        if (c == 8 || c == 24) {  // Backspace and Ctrl+X delete, unless only digits pass
            CHECK(type != RYXANDigits, what + " deleted text");
            CHECK(after == replaced(selLength, U"") ||
                      (c == 8 && selLength == 0 &&
                       after == before.substr(0, s - 1) + before.substr(s)),
                  what + " deleted other text");
            return;
        }
        CHECK(after.size() > s, what + " cut the text");
        const char32_t x = after[s];
        // Overwrite mode: the character after the caret is replaced.
        const bool overwrite = insertOn && selLength == 0 && s < before.size();
        CHECK(after == replaced(overwrite ? 1 : static_cast<size_t>(selLength), {&x, 1}),
              what + " did not replace the selection with one character");
        CHECK(x != U'\r', what + ": Enter reached the box");
        if (type == RYXANDigits) CHECK(kDigitKeys.find(x) != std::u32string_view::npos, what);
        if (type == RYXANUAlphaNumeric)
            CHECK(!isPunctuation(x) &&
                      x == static_cast<uint16_t>(form.upperCase(static_cast<int16_t>(c))),
                  what);
        if (type != RYXANDigits && type != RYXANUAlphaNumeric) CHECK(x == c, what);
        if (limit > 0 && after.size() > before.size())
            CHECK(after.size() <= static_cast<size_t>(limit), what + " went past MaxLength");
    }

    Form form;
    RYXRangeSelector* range = nullptr;
    Site* site = nullptr;
    HTextBox* boxes[2] = {};
    bool changeKey = false;
    int16_t hostKey = 0;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzedDataProvider in(data, size);
    Bench bench;
    for (int steps = 0; steps < 300 && in.remaining_bytes() > 0; ++steps) {
        bench.step(in);
        bench.checkAlways();
    }
    return 0;
}
