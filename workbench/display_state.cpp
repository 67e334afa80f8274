// The host's display state and the one-letter flags a freshly started host shows.
#include "workbench/display_state.h"

#include "shell/host/argument_blocks.h"

namespace wb {

namespace {

struct StandingLetter {
  int slot;
  char value;
};
// Plain geometry: no solid state, no rendered image, no design mode, no patterns, no
// projection remembered from rendering.
constexpr StandingLetter kStandingLetters[] = {
    {letter::kSolidState, 'w'},           {letter::kSolidRebuild, ' '}, {letter::kGeometricKind, ' '},
    {letter::kRenderImage, ' '},          {letter::kDesignMode, ' '},   {letter::kPatterns, ' '},
    {letter::kShadowKind, 'c'},           {letter::kCutType, 'b'},      {letter::kCutStyle, ' '},
    {letter::kRememberedProjection, ' '},
};

}  // namespace

void DisplayState::Reset() {
  *this = DisplayState{};
  for (const StandingLetter& standing : kStandingLetters) globc[standing.slot] = standing.value;
}

bool DisplayState::SolidState() const { return globc[letter::kSolidState] == 's'; }

void DisplayState::EnterRender() {
  renderOn = true;
  globc[letter::kSolidState] = 'w';
}

}  // namespace wb
