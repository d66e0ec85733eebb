// How the window closes: what is asked, what is stored, in the fixed order.
#pragma once

#include "shell/simulation_mode.h"
#include "shell/tool_bands.h"

#include <QRect>

// What closing asks of the window.
class ShutdownFace {
public:
    virtual ~ShutdownFace() = default;
    virtual void restoreIfMinimized() = 0;
    // Saves the document under its name, or asks for one. False where it was not written.
    virtual bool saveDocument() = 0;
    virtual void stopTimers() = 0;
    virtual QRect windowPlace() const = 0;  // pixels, when neither maximised nor minimised
    virtual int windowState() const = 0;    // 0 normal, 1 minimised, 2 maximised
    virtual ToolBandLayout toolBands() const = 0;
};

// Form_Unload. False: the window stays, since a simulation was only ended or the user chose to go on.
[[nodiscard]] bool Form_Unload(Program& program, SimulationFace& simulation, ShutdownFace& face);
