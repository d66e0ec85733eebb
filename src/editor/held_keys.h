// Which of the keys that change a gesture are held at this very instant, whatever events still wait.
#pragma once

class HeldKeys {
public:
    virtual ~HeldKeys() = default;
    virtual bool CtPressed() const = 0;  // Ctrl
    virtual bool ShPressed() const = 0;  // Shift
};
