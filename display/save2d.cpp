// 2D generation: sets aside the entities the preserve options keep, has the host build the 2D
// model of the view, hands the kept entities back, merges the result into the target file and
// restores every host setting it changed.
#include "display/save2d.h"

#include <array>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "shell/host/argument_blocks.h"
#include "shell/host/dsgmode.h"
#include "shell/host/qeldll.h"
#include "shell/host/qeldll_2d.h"

namespace HRUtility {
namespace {

constexpr std::int32_t kTargetKind = 10;
constexpr std::int32_t kCleanupKind = 1;
constexpr std::int32_t kSourceKind = 211;
constexpr const char* kRewriteSymbol = "@config@save2drewrite";
constexpr int kCleanupSlot = 41;
constexpr std::uint8_t kNoPreserveFlag = 4;
constexpr std::int32_t kLayerCount = 256;

// Saved within one Save2D call.
std::int32_t savedCleanup = 0;
std::int32_t savedRewrite = 1;

struct CategoryRow {
  std::uint8_t kind;  // byte 3
  std::uint8_t code;  // byte 1
  std::int8_t category;
};

constexpr std::array<CategoryRow, 32> kCategories = {{
    {1, 3, 0},   {2, 3, 0},   {3, 3, 0},   {5, 3, 0},   {9, 3, 0},   {1, 6, 1},   {2, 6, 1},   {4, 6, 1},
    {5, 6, 1},   {1, 7, 2},   {2, 7, 2},   {4, 7, 2},   {11, 7, 2},  {12, 7, 2},  {2, 12, 0},  {1, 21, 0},
    {2, 21, 0},  {5, 21, 0},  {2, 22, 0},  {3, 23, 0},  {9, 23, 0},  {10, 28, 0}, {3, 33, 0},  {4, 33, 0},
    {9, 33, 0},  {1, 42, 1},  {5, 42, 1},  {10, 42, 1}, {4, 44, 1},  {12, 44, 1}, {1, 45, 1},  {10, 46, 1},
}};

host::Status Run(const char* command) { return execute_internal_command(command); }
void Overlay(const char* overlay) { execute_quorvel_overlay(overlay); }

// Copies exactly the field's width, without a terminator.
template <std::size_t N>
void PutField(int first, const char (&text)[N]) {
  std::memcpy(globc + first, text, N - 1);
}

bool DesignMode() { return globc[65] == 'p'; }

// The loop reports a layer number in one byte, 256 as 0. Read as a signed byte, the numbers
// from 128 up could never match and the upper half of the layer table could not be kept.
bool OnLayer(std::uint8_t reported, std::int32_t layerNumber) {
  return layerNumber >= 1 && layerNumber <= kLayerCount && reported == static_cast<std::uint8_t>(layerNumber);
}

// A float setting rounded to the integer it stands for; values without one give 0.
std::int32_t RoundedSetting(double value) {
  const double shifted = value + 0.5;
  if (!std::isfinite(shifted) || std::fabs(shifted) >= 2147483647.0) return 0;
  return static_cast<std::int32_t>(shifted);
}

void BuildModelOfView() {
  if (globc[26] == 'w') {
    globc[78] = 'T';
    Run("create_2d_model");
    return;
  }
  globr[0] = globr[60];
  std::memcpy(globc, "hdltmp  ", 9);  // with its terminating zero
  globr[1] = 0.0F;
  globr[2] = 4000.0F;
  Run("hiden1");
  globi[1] = 1;
  Overlay("hconv");
  PutField(0, "hdltmp  ");
  globi[0] = kTargetKind;
  globc[84] = 'T';
  globc[78] = 'T';
  Run("qel_copy_file");
}

}  // namespace

std::int32_t PreserveCategory(std::uint8_t kind, std::uint8_t code) {
  for (const CategoryRow& row : kCategories) {
    if (row.kind == kind && row.code == code) return row.category;
  }
  return -1;
}

void ClearSelection() {
  globc[0] = '0';
  Overlay("qel_sel");
}

void SelectPreserved(bool dimensions, bool texts, bool walls, bool layerWanted, std::int32_t layerNumber) {
  host::EntityHandle entity = 0;
  std::uint8_t bytes[4] = {};
  std::int16_t end = 0;
  for (;;) {
    dbloop(db.handle, &entity, bytes, &end);
    if (end != 0) break;
    if (DesignMode() && IsDsgFrameEntity(db.handle, entity) != 0) continue;
    if ((bytes[2] & kNoPreserveFlag) != 0) continue;
    const std::int32_t category = PreserveCategory(bytes[3], bytes[1]);
    const bool keep = (dimensions && category == 1) || (texts && category == 2) || (walls && category == 0) ||
                      (layerWanted && OnLayer(bytes[0], layerNumber));
    if (keep) select_app_entity(db.handle, entity);
  }
  write_to_record(-1, -1);
}

void ExtractSelection() {
  globc[400] = ' ';
  globc[320] = ' ';
  Run("selection_exist");
  if (globr[0] != 1.0F) return;
  if (DesignMode()) {
    PutField(0, "prespdsg");
  } else {
    PutField(0, "presp   ");
  }
  globr[9] = 1.0F;
  Overlay("extract");
}

void BlankForGeneration() {
  for (const char mode : {'3', '1', '4'}) {
    globc[0] = mode;
    Overlay("blank");
  }
}

bool IsTargetFree(const char* fileName) {
  char userText[host::kLockTextSize] = {};
  char detailText[host::kLockTextSize] = {};
  return Session_CheckLockEx(fileName, userText, detailText) != 1;
}

void SetLineCleanup(std::uint8_t removeCoincident, std::uint8_t lineMerge) {
  savedCleanup = RoundedSetting(globr[kCleanupSlot]);
  globr[kCleanupSlot] = static_cast<float>((removeCoincident != 0 ? 1 : 0) + (lineMerge != 0 ? 2 : 0));
}

void RestoreLineCleanup() { globr[kCleanupSlot] = static_cast<float>(savedCleanup); }

void ExtractInto2D() {
  globi[0] = kTargetKind;
  globc[84] = 'T';
  PutField(9, "_save2d_");
  char* file = GetFileFromSpecialDir(globi[0], globc[84]);
  std::int32_t word = 0;
  qel_put_long_name(file != nullptr ? file : "", kCleanupKind, &word);
  if (file != nullptr) log_free(file);
  if (DesignMode()) {
    PutField(8, "prespdsg");
  } else {
    PutField(8, "presp   ");
  }
  globr[9] = 0.0F;
  Overlay("extract");
}

void SetRewriteSwitch(std::int32_t value) {
  std::int32_t current = 1;
  char* text = nullptr;
  if (GetSymbolString(kRewriteSymbol, &text) != 0) {
    if (text != nullptr) current = RoundedSetting(std::strtod(text, nullptr));
  }
  if (text != nullptr) log_free(text);
  savedRewrite = current;
  if (current != value) {
    char number[16];
    std::snprintf(number, sizeof number, "%i", value);
    SetSymbolString(kRewriteSymbol, number);
  }
}

void RestoreRewriteSwitch() {
  char number[16];
  std::snprintf(number, sizeof number, "%i", savedRewrite);
  SetSymbolString(kRewriteSymbol, number);
}

void UnblankAfterGeneration() {
  globc[0] = '0';
  Overlay("blank");
  if (globr[0] != 1.0F) {
    globc[0] = '6';
    globr[114] = 0.0F;
    Overlay("blank");
    if (globr[114] == 1.0F) return;
    globr[0] = 255.0F;
  }
  globc[0] = '2';
  Overlay("blank");
}

bool Save2D(const std::string& target, std::uint8_t autoClip, std::uint8_t overwrite, std::uint8_t removeCoincident,
            std::uint8_t lineMerge, std::uint8_t preserveDimensions, std::uint8_t preserveText,
            std::uint8_t preserveWalls, std::uint8_t preserveLayer, std::int16_t preserveLayerIndex) {
  // Asked before anything is set aside: finding the file in use after blanking the kept
  // entities would leave them hidden in the drawing.
  const char* registered = qel_get_long_name(kTargetKind);
  const std::string name = registered != nullptr ? registered : "";
  if (!IsTargetFree(name.c_str())) return false;

  const bool preserve =
      (preserveDimensions != 0 || preserveText != 0 || preserveWalls != 0 || preserveLayer != 0) && globc[26] == 'w';
  if (preserve) {
    ClearSelection();
    SelectPreserved(preserveDimensions != 0, preserveText != 0, preserveWalls != 0, preserveLayer != 0,
                    preserveLayerIndex + 1);
    ExtractSelection();
    BlankForGeneration();
  }
  globr[147] = 3.0F;

  PutField(9, "_save2d_");
  BuildModelOfView();

  std::int32_t word = -1;
  SetLineCleanup(removeCoincident, lineMerge);
  globr[31] = 0.01F;
  if (globr[kCleanupSlot] != 0.0F) {
    qel_put_long_name(target.c_str(), kCleanupKind, &word);
    globr[0] = globp[41].x;
    globr[1] = 52.0F;
    globr[2] = globp[41].y;
    globr[3] = globp[41].z;
    globr[4] = -1.0F;
    globi[0] = kTargetKind;
    globc[0] = 'T';
    Overlay("shadows");
  }
  if (preserve) ExtractInto2D();

  globi[0] = kTargetKind;
  globi[1] = kSourceKind;
  globc[84] = 'T';
  globc[78] = '*';
  PutField(9, "_save2d_");
  qel_put_long_name(name.c_str(), kSourceKind, &word);
  Run("save2d_add_source");

  SetRewriteSwitch(overwrite);
  // The merge is what writes the file: a merge that failed is no saved drawing, though the
  // settings are put back all the same.
  const bool merged = Run("merge_save2d_files") == host::kOk;
  RestoreRewriteSwitch();
  // Clipping after a failed merge would rewrite the old drawing the failure left in place.
  if (autoClip != 0 && merged) Run("AutoClip");
  RestoreLineCleanup();
  if (preserve) {
    UnblankAfterGeneration();
    ClearSelection();
  }
  return merged;
}

}  // namespace HRUtility
