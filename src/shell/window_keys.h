// The keyboard of the window: what is held now, and the platform's key events as the editor's key codes.
#pragma once

#include "editor/held_keys.h"
#include "editor/keyboard.h"

class QKeyEvent;

class WindowKeys : public HeldKeys {
public:
    bool CtPressed() const override;
    bool ShPressed() const override;
};

// A key that has no code among kKey... gives key 0.
KeyDown keyDownOf(const QKeyEvent& event);
