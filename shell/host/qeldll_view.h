// Calls into the host's main library that read and set the view: projection, view window,
// scale keeping, redraw, the layer table and the wait cursor.
#pragma once

#include <cstdint>

#include "shell/host/host_types.h"

namespace host {

// One entry of the host's layer table; state 255 means the layer is off.
struct LayerEntry {
  std::int32_t state;
  std::int32_t reserved;
};
static_assert(sizeof(LayerEntry) == 8);

constexpr std::int32_t kLayerOffState = 255;
constexpr int kHostLayerCount = 256;

using LayerTableHandle = std::int32_t;

}  // namespace host

extern "C" {

// Wait cursor: every add is matched by a remove.
void add_wait_cur();
void remove_wait_cur();

// The 2D view window, four doubles in the host's order (x min, y min, x max, y max).
void wn3_inq_view_rect(double rect[4]);
void wn3_set_view_rect(const double rect[4]);
void wn3_auto_window(std::int32_t mode);
void wn3_dl_redraw(std::int32_t mode);
void init_hdl_redraw_draw_params();

// Switch the view to 2D or 3D.
void execute_2d();
void execute_3d();

// Scale keeping: fixed scaling keeps the present scale across view changes.
std::int32_t wnp_fixed_scaling();
std::int32_t wnp_auto_scaling();
double dBox_calc_scale();
void dBox_window_set_keep_scale(float scale);
std::int32_t dBox_window_keep_scale();

// The layer table of the current drawing: 256 entries owned by the host.
const host::LayerEntry* GetLayersInCurrentHDL();
host::LayerTableHandle HDL_Main();
host::Status HDL_Set_Layer_On(host::LayerTableHandle table, std::int32_t layer);
host::Status HDL_Set_Layer_Off(host::LayerTableHandle table, std::int32_t layer);
// The layer's name (host-owned, valid until the next layer call); null for a bad index.
const char* HDL_Get_LayerName(host::LayerTableHandle table, std::int32_t layer);

}  // extern "C"
