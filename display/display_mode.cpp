// Display modes: the query reads the host's display letters, each switch writes the letters
// and runs the host commands that put the host into that mode.
#include "display/display_mode.h"

#include <cmath>
#include <cstring>

#include "shell/host/argument_blocks.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_view.h"
#include "views/section_symbols.h"

namespace HRUtility {
namespace {

void Run(const char* command) { execute_internal_command(command); }
void Overlay(const char* overlay) { execute_quorvel_overlay(overlay); }

// The toolbar overlay reads exactly eight characters; globc[8] stays as it is.
void ShowToolbar(const char (&name)[9]) {
  std::memcpy(globc, name, 8);
  globr[0] = 4.0F;
  Overlay("toolbar");
}

bool RenderOn() {
  Run("inq_render_mode");
  return globr[0] == 1.0F;
}

float TextVisibility() { return SectionsShown != 0 ? 1.0F : globr[103]; }

std::int16_t SolidModeFromLetter() {
  Run("inq_dspmode_info");
  switch (globc[0]) {
    case 'w': return kWireframe;
    case 'h': return kHiddenline;
    case 's': return kSurfaces;
    case 'S': return kShaded;
    case 'M': return kMonocromatic;
    case 'b': return kSolidBlank;
    case 'o': return globc[83] == 's' ? kShadowModel : globc[83] == 'd' ? kShadowTerrain : kUnknownMode;
    case 'O': return globc[83] == 's' ? kMonoShadowModel : globc[83] == 'd' ? kMonoShadowTerrain : kUnknownMode;
    default: return kUnknownMode;
  }
}

void SwitchToGeometric() {
  if (RenderOn()) {
    globc[36] = ' ';
    globc[0] = 'm';
    Run("set_dspmode_info");
    Run("gloff");
    Run("rnd_clear");
    globr[0] = 0.0F;
    Run("render_on");
    Run("rnd_smain_off");
    Run(globc[403] == 'a' ? "set_perspective" : "set_parallel");
  } else if (globc[26] == 's') {
    globr[1] = 3.0F;
    Overlay("hidlin2d");
    globc[65] = ' ';
    globc[26] = 'w';
    globc[32] = ' ';
    globi[10] = 0;
    globr[144] = globr[143];
    globc[27] = ' ';
    globp[25].y = 1.0F;
    Run("set_background_color");
    globc[0] = 'a';
    globr[0] = 0.0F;
    globp[25].x = 0.0F;
    Run("wire_frame_all");
    globr[68] = 1.0F;
    Run("regen");
  } else {
    return;  // already plain geometry
  }
  ShowToolbar("GEOM    ");
  // Back in plain geometry the section symbols are shown again: the overlay re-enters this
  // library's entry with sub-command 3.
  globi[0] = 3;
  Overlay("Pandex");
}

void SwitchToRender() {
  if (globr[132] != 3.0F) execute_3d();
  Run("inq_persp_mode");
  globc[403] = globr[0] == 1.0F ? 'a' : 'e';
  globr[0] = 1.0F;
  if (globr[1] != 1.0F) Run("render_on");
  Run("rnd_make");
  if (globr[1] != 1.0F) Run("rnd_smain");
  ShowToolbar("RENDER  ");
  Run("redraw_all");
}

void SetUpSolidState(std::int32_t code) {
  globr[1] = 2.0F;
  Overlay("hidlin2d");
  globr[0] = globr[103];
  globi[10] = 0;
  globp[25].y = 1.0F;
  globc[109] = 'o';
  globc[26] = 's';
  Run("set_background_color");
  globr[0] = 0.0F;
  Run("wireframe_all");
  globc[0] = 'b';
  Run("set_dspmode_info");
  globr[0] = TextVisibility();
  Run("draw_text_on_off");
  globc[27] = 'f';
  Run("new_solid");
  globc[1] = 'n';
  Run("redraw_all");
  ShowToolbar("SOLID   ");
  globp[38].z = 1.0F;
  globp[26].y = 3.0F;
  globp[25].x = 0.0F;
  if (code != kWireframe) globp[25].x = 1.0F;
}

void SwitchToSolid(std::int32_t code) {
  if (RenderOn()) {
    Run("rnd_clear");
    globr[0] = 0.0F;
    Run("render_on");
    Run("rnd_smain_off");
    Run("redraw_all");
  }
  if (globc[26] != 's') SetUpSolidState(code);

  // Shadow modes differ from their partners by the light height and the letter the query
  // reads back: terrain 0.0 and 'd', model 2.0 and 's'.
  const auto shadow = [](float height, char letter, const char* command) {
    globp[38].z = height;
    globc[83] = letter;
    globp[26].y = 3.0F;
    Run(command);
  };
  switch (code) {
    case kWireframe:
      globr[0] = 1.0F;
      globc[83] = 'c';
      Run("wireframe");
      break;
    case kHiddenline:
      globc[83] = 'c';
      Run("hidden_lines");
      break;
    case kSurfaces:
      globp[38].z = 1.0F;
      globp[26].y = 1.0F;
      globc[83] = 's';
      Run("shaded_surfaces");
      break;
    case kShaded:
      globp[38].z = 1.0F;
      globp[26].y = 3.0F;
      Run("shaded_surfaces");
      globc[83] = 's';
      break;
    case kMonocromatic:
      globp[38].z = 1.0F;
      globp[26].y = 3.0F;
      Run("shaded_pale_surfaces");
      globc[83] = 's';
      break;
    case kShadowTerrain: shadow(0.0F, 'd', "shadowed_surfaces"); break;
    case kShadowModel: shadow(2.0F, 's', "shadowed_surfaces"); break;
    case kMonoShadowTerrain: shadow(0.0F, 'd', "shadowed_pale_surfaces"); break;
    case kMonoShadowModel: shadow(2.0F, 's', "shadowed_pale_surfaces"); break;
    default: break;
  }
}

// globr[2] truncated toward zero; a value with no integer form switches nothing.
std::int32_t RequestedCode() {
  const float value = globr[2];
  if (!std::isfinite(value) || std::fabs(value) > 1000.0F) return kUnknownMode;
  return static_cast<std::int32_t>(value);
}

}  // namespace

std::int16_t GetDisplayMode() {
  if (globc[36] == 'g') return kRender;
  if (globc[65] == 'p') return kDesign;
  if (globc[26] == 'w') {
    if (globc[32] == 'a') return kGeometricA;
    if (globc[32] == 'r') return kGeometricR;
    Run("inq_render_mode");
    return globr[0] != 0.0F ? kRender : kGeometric;
  }
  if (globc[26] == 's') return SolidModeFromLetter();
  return kUnknownMode;
}

std::int16_t SetDisplayMode(std::int16_t code) {
  globr[2] = static_cast<float>(code);
  if (code >= kGeometric && code <= kRender) ModeSwitch();
  return 0;
}

void ModeSwitch() {
  const std::int32_t code = RequestedCode();
  if (code == kGeometric) {
    SwitchToGeometric();
  } else if (code == kRender) {
    SwitchToRender();
  } else if (code >= kWireframe && code <= kMonoShadowModel) {
    SwitchToSolid(code);
  }
}

bool IsModeAcceptable() {
  return (globc[26] == 'w' || globc[26] == 's' || globc[36] == 'g') && globc[32] != 'a' && globc[32] != 'r';
}

}  // namespace HRUtility
