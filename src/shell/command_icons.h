// The pictures of commands and controls: drawings of one style that take their colour from the palette of the moment,
// sharp at every size and scale.
#pragma once

#include <QColor>
#include <QCursor>
#include <QIcon>

#include <string_view>

// name: a file of assets/icons without its ending. A disabled picture is drawn in the palette's disabled text colour.
QIcon commandIcon(std::string_view name);

// The same with a bar of the colour below it, for a button that chooses this colour.
QIcon colorIcon(std::string_view name, const QColor& color);

// The pointer of the drawing tools; its hot spot is the pencil's tip.
QCursor pencilPointer(double devicePixelRatio);
