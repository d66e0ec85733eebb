#include "shell/dialogs/number_field.h"

#include "shell/options_logic.h"

#include <QFocusEvent>
#include <QTimer>

#include <algorithm>

QValidator::State DigitsOnly::validate(QString& input, int&) const {
    const auto digit = [](QChar letter) { return IsValidDigitKey(letter.unicode()); };
    return std::ranges::all_of(input, digit) ? Acceptable : Invalid;
}

NumberField::NumberField(const char* name, int mostDigits, QWidget* parent) : QLineEdit(parent) {
    setObjectName(name);
    setValidator(new DigitsOnly(this));
    setMaxLength(mostDigits);
    setFixedWidth(fontMetrics().horizontalAdvance(QString(8, '0')));
}

void NumberField::focusInEvent(QFocusEvent* event) {
    QLineEdit::focusInEvent(event);
    // After a click the press that follows would put the cursor and take the selection away again.
    if (event->reason() == Qt::MouseFocusReason) QTimer::singleShot(0, this, &QLineEdit::selectAll);
}
