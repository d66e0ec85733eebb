#include "shell/object_panel.h"

#include "shell/command_icons.h"
#include "shell/window_host.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QMouseEvent>
#include <QSignalBlocker>
#include <QTableWidget>
#include <QToolButton>
#include <QVBoxLayout>

namespace {

// 300 and 450 twips, and more where the font is tall.
constexpr int kRowPixels = 20;
constexpr int kTwoLineRowPixels = 30;
constexpr int kRowMargin = 4;

int rowPixels(const QFontMetrics& font, bool twoLines) {
    return std::max(twoLines ? kTwoLineRowPixels : kRowPixels, font.height() * (twoLines ? 2 : 1) + kRowMargin);
}

}  // namespace

ObjectPanel::ObjectPanel(QWidget* parent) : QWidget(parent) {
    auto* modes = new QHBoxLayout;
    modes->setSpacing(4);
    modes->addWidget(modeButton(kToggleFixtures, "Fixtures", "Select single fixtures"));
    modes->addWidget(modeButton(kToggleProps, "Props", "Select whole props"));

    flgObjectSelect_ = new QTableWidget(0, 1, this);
    flgObjectSelect_->setObjectName("flgObjectSelect");
    flgObjectSelect_->horizontalHeader()->hide();
    flgObjectSelect_->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
    flgObjectSelect_->verticalHeader()->hide();
    flgObjectSelect_->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    // The highlight is what the editor has selected; a right press or a drag over the rows must not move it.
    flgObjectSelect_->setSelectionMode(QAbstractItemView::NoSelection);
    flgObjectSelect_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    flgObjectSelect_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    flgObjectSelect_->setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
    flgObjectSelect_->setShowGrid(false);
    flgObjectSelect_->setAlternatingRowColors(true);
    flgObjectSelect_->setWordWrap(false);
    flgObjectSelect_->setTextElideMode(Qt::ElideRight);
    flgObjectSelect_->setFocusPolicy(Qt::NoFocus);  // Tab and the arrows belong to the form
    connect(flgObjectSelect_, &QTableWidget::cellClicked, this, [this](int row, int) {
        if (flgObjectSelect_Click) flgObjectSelect_Click(row);
    });

    chkSimplePropMode_ = new QCheckBox(tr("One row a prop"), this);
    chkSimplePropMode_->setObjectName("chkSimplePropMode");
    chkSimplePropMode_->setToolTip(tr("List each prop once instead of fixture by fixture"));
    chkSimplePropMode_->setFocusPolicy(Qt::NoFocus);
    connect(chkSimplePropMode_, &QCheckBox::clicked, this, [this](bool simple) {
        if (chkSimplePropMode_Click) chkSimplePropMode_Click(simple);
    });

    auto* column = new QVBoxLayout(this);
    column->setContentsMargins(8, 2, 2, 4);
    column->setSpacing(5);
    column->addLayout(modes);
    column->addWidget(flgObjectSelect_);
    column->addWidget(chkSimplePropMode_);
    setMinimumWidth(150);
}

QToolButton* ObjectPanel::modeButton(int index, const char* text, const char* tip) {
    auto* button = new QToolButton(this);
    button->setObjectName(QString("chkCmdFixtureOrProp(%1)").arg(index));
    button->setText(tr(text));
    button->setToolTip(tr(tip));
    button->setIcon(commandIcon(index == kToggleFixtures ? "select-fixture" : "select-prop"));
    button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    button->setCheckable(true);
    button->setChecked(index == kToggleFixtures);
    button->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    button->setFocusPolicy(Qt::NoFocus);
    button->installEventFilter(this);
    connect(button, &QToolButton::clicked, this, [this, index] {
        if (chkCmdFixtureOrProp_MouseUp) chkCmdFixtureOrProp_MouseUp(index, true);
    });
    chkCmdFixtureOrProp_[static_cast<std::size_t>(index)] = button;
    return button;
}

bool ObjectPanel::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::MouseButtonRelease) return QWidget::eventFilter(watched, event);
    const auto& release = *static_cast<QMouseEvent*>(event);
    const auto button = std::ranges::find(chkCmdFixtureOrProp_, watched);
    if (release.button() == Qt::LeftButton || button == chkCmdFixtureOrProp_.end()) return false;
    const int index = static_cast<int>(button - chkCmdFixtureOrProp_.begin());
    if (chkCmdFixtureOrProp_MouseUp) chkCmdFixtureOrProp_MouseUp(index, false);
    return true;
}

void ObjectPanel::showRows(std::vector<ZephListEntry> rows) {
    rows_ = std::move(rows);
    const bool twoLines =
        std::ranges::any_of(rows_, [](const ZephListEntry& row) { return row.Text.find('\n') != std::string::npos; });
    flgObjectSelect_->setUpdatesEnabled(false);
    flgObjectSelect_->clearContents();
    flgObjectSelect_->setRowCount(static_cast<int>(rows_.size()));
    flgObjectSelect_->verticalHeader()->setDefaultSectionSize(rowPixels(fontMetrics(), twoLines));
    const QIcon locked = commandIcon("lock");
    for (int row = 0; row < static_cast<int>(rows_.size()); ++row) {
        const ZephListEntry& entry = rows_[static_cast<std::size_t>(row)];
        auto* item = new QTableWidgetItem(toQString(entry.Text));
        item->setToolTip(item->text());
        if (entry.Locked) item->setIcon(locked);
        flgObjectSelect_->setItem(row, 0, item);
    }
    flgObjectSelect_->setUpdatesEnabled(true);
    ZephDeselectflg();
}

void ObjectPanel::ZephDeselectflg() {
    flgObjectSelect_->selectionModel()->clearSelection();
}

void ObjectPanel::ZephHighlightflg(std::int32_t object) {
    const auto row = std::ranges::find(rows_, object, &ZephListEntry::Object);
    if (row != rows_.end()) highlightRow(static_cast<int>(row - rows_.begin()));
}

int ObjectPanel::highlightedRow() const {
    const QModelIndexList selected = flgObjectSelect_->selectionModel()->selectedIndexes();
    return selected.isEmpty() ? -1 : selected.front().row();
}

void ObjectPanel::highlightRow(int row) {
    const QModelIndex cell = flgObjectSelect_->model()->index(row, 0);
    flgObjectSelect_->selectionModel()->select(cell, QItemSelectionModel::ClearAndSelect);
    flgObjectSelect_->scrollTo(cell);
}

void ObjectPanel::showModeButtons(int pressed) {
    for (int index = 0; index < 2; ++index)
        chkCmdFixtureOrProp_[static_cast<std::size_t>(index)]->setChecked(index == pressed);
}

void ObjectPanel::showSimplePropMode(bool simple, bool visible) {
    chkSimplePropMode_->setChecked(simple);
    chkSimplePropMode_->setVisible(visible);
}

void ObjectPanel::setModeButtonsEnabled(bool enabled) {
    for (QToolButton* button : chkCmdFixtureOrProp_)
        button->setEnabled(enabled);
}
