// A box to type a whole number into. Its text is what was typed, so that each dialog says in its own words what is
// wrong with it.
#pragma once

#include <QLineEdit>
#include <QValidator>

// Keeps everything but digits out of a field, be it typed or pasted.
class DigitsOnly : public QValidator {
public:
    using QValidator::QValidator;
    State validate(QString& input, int& position) const override;
};

class NumberField : public QLineEdit {
public:
    NumberField(const char* name, int mostDigits, QWidget* parent = nullptr);

protected:
    // All of it is selected, so that typing replaces what stands there.
    void focusInEvent(QFocusEvent* event) override;
};
