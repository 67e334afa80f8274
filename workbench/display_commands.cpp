// Commands and overlays over the host's display: rendering, the display letter of the solid
// modes, background, texts, toolbar, 2D hidden lines and hatch patterns.
#include "shell/host/argument_blocks.h"
#include "workbench/command_table.h"
#include "workbench/display_state.h"
#include "workbench/workbench.h"

namespace wb {

namespace {

constexpr int kBackgroundSlot = 25;     // globp: .y holds the colour index
constexpr int kShadingSlot = 26;        // globp: .y is 1.0 for plain surfaces, else shaded
constexpr float kHiddenLinesOn = 2.0F;  // globr[1] handed to hidlin2d
constexpr float kHiddenLinesOff = 3.0F;
constexpr float kHighestColour = 255.0F;

DisplayState& Display() { return Workbench::Get().Display(); }

host::Status InquireRender() {
  globr[0] = Display().renderOn ? 1.0F : 0.0F;
  return host::kOk;
}

host::Status SwitchRender() {
  if (globr[0] == 1.0F) {
    Display().EnterRender();
  } else {
    Display().renderOn = false;
  }
  return host::kOk;
}

// Rendering is a render mode of its own, whether or not render_on came first.
host::Status MakeRendering() {
  DisplayState& display = Display();
  display.EnterRender();
  display.renderImage = true;
  display.glSurface = true;
  globc[letter::kRenderImage] = 'g';
  return host::kOk;
}

host::Status ShowRenderWindow() {
  Display().renderWindowShown = true;
  return host::kOk;
}

host::Status HideRenderWindow() {
  Display().renderWindowShown = false;
  return host::kOk;
}

host::Status ClearRendering() {
  Display().renderImage = false;
  globc[letter::kRenderImage] = ' ';
  return host::kOk;
}

host::Status CloseRenderSurface() {
  Display().glSurface = false;
  return host::kOk;
}

host::Status SetDisplayLetter() {
  if (globc[letter::kDisplay] == '\0') return 0;
  Display().displayLetter = globc[letter::kDisplay];
  return host::kOk;
}

host::Status InquireDisplayLetter() {
  globc[letter::kDisplay] = Display().displayLetter;
  return host::kOk;
}

// The solid drawing styles exist only in the solid state. globc[83] (shadow kind) stays as the
// plug-in wrote it: it is what tells the shadow modes apart on the way back.
host::Status DrawSolidAs(char displayLetter) {
  DisplayState& display = Display();
  if (!display.SolidState()) return 0;
  display.displayLetter = displayLetter;
  return host::kOk;
}

host::Status Wireframe() { return DrawSolidAs('w'); }
host::Status HiddenLines() { return DrawSolidAs('h'); }
host::Status ShadedSurfaces() { return DrawSolidAs(globp[kShadingSlot].y == 1.0F ? 's' : 'S'); }
host::Status ShadedPaleSurfaces() { return DrawSolidAs('M'); }
host::Status ShadowedSurfaces() { return DrawSolidAs('o'); }
host::Status ShadowedPaleSurfaces() { return DrawSolidAs('O'); }

host::Status AllEdgesAsWires() {
  ++Display().allWireResets;
  // Back in plain geometry the model is shown whole again.
  if (globc[letter::kSolidState] == 'w') DropCuts();
  return host::kOk;
}

host::Status NewSolid() {
  DisplayState& display = Display();
  ++display.solidBuilds;
  if (globc[letter::kSolidRebuild] == 'f') ++display.freshSolidBuilds;
  // A section or plan view hands its cut over with the solid build (globc[243] 's').
  TakeCutFromSolidBuild();
  return host::kOk;
}

host::Status SetBackgroundColour() {
  const float colour = globp[kBackgroundSlot].y;
  if (!(colour >= 0.0F && colour <= kHighestColour)) return 0;  // also refuses NaN
  Display().backgroundColor = static_cast<int>(colour);
  return host::kOk;
}

host::Status SwitchTexts() {
  Display().textShown = globr[0] != 0.0F;
  return host::kOk;
}

host::Status ShowToolbar() {
  Display().toolbar.assign(globc, kToolbarNameLength);
  return host::kOk;
}

host::Status SwitchHiddenLines2d() {
  if (globr[1] != kHiddenLinesOn && globr[1] != kHiddenLinesOff) return 0;
  Display().hiddenLine2d = globr[1] == kHiddenLinesOn;
  return host::kOk;
}

// The caller reads globc[66] back to learn whether the patterns are shown.
host::Status RefreshHatchPatterns() {
  DisplayState& display = Display();
  display.hatchPatterns = globc[letter::kPatterns] == 'h' && display.patternsShowable;
  if (!display.hatchPatterns) globc[letter::kPatterns] = ' ';
  return host::kOk;
}

constexpr NamedCommand kDisplayCommands[] = {
    {"inq_render_mode", &InquireRender},
    {"render_on", &SwitchRender},
    {"rnd_make", &MakeRendering},
    {"rnd_smain", &ShowRenderWindow},
    {"rnd_smain_off", &HideRenderWindow},
    {"rnd_clear", &ClearRendering},
    {"gloff", &CloseRenderSurface},
    {"set_dspmode_info", &SetDisplayLetter},
    {"inq_dspmode_info", &InquireDisplayLetter},
    {"wireframe", &Wireframe},
    {"hidden_lines", &HiddenLines},
    {"shaded_surfaces", &ShadedSurfaces},
    {"shaded_pale_surfaces", &ShadedPaleSurfaces},
    {"shadowed_surfaces", &ShadowedSurfaces},
    {"shadowed_pale_surfaces", &ShadowedPaleSurfaces},
    // Both spellings are in use.
    {"wire_frame_all", &AllEdgesAsWires},
    {"wireframe_all", &AllEdgesAsWires},
    {"new_solid", &NewSolid},
    {"set_background_color", &SetBackgroundColour},
    {"draw_text_on_off", &SwitchTexts},
};

constexpr NamedCommand kDisplayOverlays[] = {
    {"toolbar", &ShowToolbar},
    {"hidlin2d", &SwitchHiddenLines2d},
    {"refh", &RefreshHatchPatterns},
};

}  // namespace

std::span<const NamedCommand> DisplayCommands() { return kDisplayCommands; }
std::span<const NamedCommand> DisplayOverlays() { return kDisplayOverlays; }

}  // namespace wb
