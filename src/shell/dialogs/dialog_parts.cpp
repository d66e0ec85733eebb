#include "shell/dialogs/dialog_parts.h"

QGroupBox* groupBox(const QString& title, QLayout* inside) {
    auto* box = new QGroupBox(title);
    box->setLayout(inside);
    return box;
}

QFormLayout* labelledForm() {
    auto* layout = new QFormLayout;
    layout->setLabelAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    layout->setFieldGrowthPolicy(QFormLayout::FieldsStayAtSizeHint);
    layout->setHorizontalSpacing(kDialogGapPx);
    return layout;
}

QHBoxLayout* rowOf(std::initializer_list<QWidget*> widgets) {
    auto* layout = new QHBoxLayout;
    for (QWidget* widget : widgets)
        layout->addWidget(widget);
    return layout;
}

QPushButton* pushButton(const char* name, const QString& text) {
    auto* made = new QPushButton(text);
    made->setObjectName(name);
    made->setAutoDefault(false);
    return made;
}

QLabel* valueLabel(const char* name, const QString& text) {
    auto* label = new QLabel;
    label->setObjectName(name);
    label->setTextFormat(Qt::PlainText);
    label->setText(text);
    return label;
}

QHBoxLayout* closingRow(QPushButton* ok, QPushButton* cancel) {
    ok->setDefault(true);
    auto* row = new QHBoxLayout;
    row->addStretch();
    row->addWidget(ok);
    row->addWidget(cancel);
    return row;
}

void layOutBesidePicture(QWidget* picture, std::initializer_list<QWidget*> groups, QHBoxLayout* closing,
                         QWidget& dialog) {
    auto* right = new QVBoxLayout;
    for (QWidget* group : groups)
        right->addWidget(group);
    right->addStretch();
    auto* sides = new QHBoxLayout;
    sides->setSpacing(kDialogGapPx);
    sides->addWidget(picture);
    sides->addLayout(right, 1);
    auto* column = new QVBoxLayout(&dialog);
    column->setContentsMargins(kDialogGapPx, kDialogGapPx, kDialogGapPx, kDialogGapPx);
    column->setSpacing(kDialogGapPx);
    column->addLayout(sides);
    column->addLayout(closing);
    column->setSizeConstraint(QLayout::SetFixedSize);
}
