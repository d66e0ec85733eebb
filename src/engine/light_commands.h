// Commands on their way from the link to the render table.
#pragma once

#include "engine/render_table.h"
#include "link/light_command.h"
#include "util/clock.h"

// Files a command with its channel, from nowMs on; an address without a channel is ignored.
void ZephAddLightCommand(const ZephLightCommand& command, const ZephLightTiming& timing, std::int32_t nowMs,
                         ZephRenderTables& tables);

// What the link hands its commands to during a simulation.
class RenderTableSink : public CommandSink {
public:
    RenderTableSink(ZephRenderTables& tables, const Clock& clock) : tables_(tables), clock_(clock) {}
    void addLightCommands(std::span<const ZephChannelCommand> commands) override;
    std::int32_t virtualChannelKey(std::string_view latin1Name) const override;

private:
    ZephRenderTables& tables_;
    const Clock& clock_;
};
