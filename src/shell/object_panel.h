// The panel beside the canvas: the two mode buttons, the list of objects and the switch for whole props. It shows and
// reports; what a click does is decided by the procedures that it is handed to.
#pragma once

#include "editor/object_list.h"

#include <QWidget>

#include <functional>

class QCheckBox;
class QTableWidget;
class QToolButton;

class ObjectPanel : public QWidget {
public:
    explicit ObjectPanel(QWidget* parent);

    // rows: what the list shows from now on, nothing highlighted.
    void showRows(std::vector<ZephListEntry> rows);
    void ZephDeselectflg();
    // Highlights the row of a fixture; nothing where it has none.
    void ZephHighlightflg(std::int32_t object);
    void showModeButtons(int pressed);  // kToggleFixtures or kToggleProps
    void showSimplePropMode(bool simple, bool visible);
    void setModeButtonsEnabled(bool enabled);

    int rows() const { return static_cast<int>(rows_.size()); }
    int highlightedRow() const;  // from 0, -1 = none
    void highlightRow(int row);
    std::int32_t objectOfRow(int row) const { return rows_.at(static_cast<std::size_t>(row)).Object; }

    std::function<void(int row)> flgObjectSelect_Click;
    std::function<void(int button, bool left)> chkCmdFixtureOrProp_MouseUp;
    std::function<void(bool simple)> chkSimplePropMode_Click;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QToolButton* modeButton(int index, const char* text, const char* tip);

    std::array<QToolButton*, 2> chkCmdFixtureOrProp_{};
    QTableWidget* flgObjectSelect_ = nullptr;
    QCheckBox* chkSimplePropMode_ = nullptr;
    std::vector<ZephListEntry> rows_;
};
