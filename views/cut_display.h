// The host's cut display, shared by the section cut and the plan view: the solid state in which
// the host draws a model cut, coloured by the cut type.
#pragma once

#include <cstdint>

namespace cut_display {

// The host still renders after being asked to stop, so no cut can be shown.
constexpr std::int16_t kRenderStillOn = -28;

// Asks the host; true while it renders.
bool RenderingActive();
// Hands over the cut type, puts the host into the solid state when it is not there yet and
// sets the 'b' display letter.
void Begin(char cutType);
// Builds the solid model afresh, redraws, and leaves the host on the given display letter.
void Finish(char displayLetter);

}  // namespace cut_display
