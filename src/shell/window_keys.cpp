#include "shell/window_keys.h"

#include <QGuiApplication>
#include <QKeyEvent>

namespace {

struct KeyRow {
    int qtKey;
    int plain;   // its code
    int keypad;  // its code on the number pad
};

constexpr KeyRow kKeys[] = {
    {Qt::Key_Tab, kKeyTab, kKeyTab},
    {Qt::Key_Backtab, kKeyTab, kKeyTab},
    {Qt::Key_Return, kKeyEnter, kKeyEnter},
    {Qt::Key_Enter, kKeyEnter, kKeyEnter},
    {Qt::Key_Escape, kKeyEsc, kKeyEsc},
    {Qt::Key_End, kKeyEnd, kKeyEnd},
    {Qt::Key_Delete, kKeyDel, kKeyDel},
    {Qt::Key_C, kKeyC, kKeyC},
    {Qt::Key_V, kKeyV, kKeyV},
    {Qt::Key_X, kKeyX, kKeyX},
    {Qt::Key_Menu, kKeyApps, kKeyApps},
    {Qt::Key_Plus, kKeyEquals, kKeyNumpadAdd},
    {Qt::Key_Equal, kKeyEquals, kKeyEquals},
    {Qt::Key_Minus, kKeyMinus, kKeyNumpadSubtract},
    {Qt::Key_Underscore, kKeyMinus, kKeyMinus},
};

}  // namespace

bool WindowKeys::CtPressed() const {
    return QGuiApplication::queryKeyboardModifiers().testFlag(Qt::ControlModifier);
}

bool WindowKeys::ShPressed() const {
    return QGuiApplication::queryKeyboardModifiers().testFlag(Qt::ShiftModifier);
}

KeyDown keyDownOf(const QKeyEvent& event) {
    KeyDown down;
    const auto row = std::ranges::find(kKeys, event.key(), &KeyRow::qtKey);
    if (row != std::end(kKeys)) {
        down.key = event.modifiers().testFlag(Qt::KeypadModifier) ? row->keypad : row->plain;
    }
    down.ctrl = event.modifiers().testFlag(Qt::ControlModifier);
    // A plus or an underscore means what it says on every layout, whether or not it takes Shift there.
    const bool shifted =
        event.key() == Qt::Key_Plus || event.key() == Qt::Key_Underscore || event.key() == Qt::Key_Backtab;
    down.shift = event.modifiers().testFlag(Qt::ShiftModifier) || shifted;
    return down;
}
