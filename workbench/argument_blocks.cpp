// The host's argument blocks and the standing settings of a freshly started host.
#include "workbench/argument_blocks.h"

#include <algorithm>
#include <iterator>

#include "shell/host/argument_blocks.h"

std::int32_t globi[host::kGlobiSize];
float globr[host::kGlobrSize];
host::Point3f globp[host::kGlobpSize];
char globc[host::kGlobcSize];
host::DbBlock db;

namespace wb {

namespace {

// The settings a fresh host starts with, in one place. Texts take their look from these slots
// when a text is made with the current settings; dialogs take units and decimals from them.
struct FloatSetting {
  int slot;
  float value;
};
constexpr FloatSetting kFloatSettings[] = {
    {20, 1.0F},   // width factor used when the text height is given negative
    {22, 2.5F},   // text height
    {23, 0.0F},   // text angle
    {24, 0.0F},   // justification
    {25, 1.0F},   // text width factor
    {26, 12.0F},  // font number
    {50, 0.0F},   // slant
    {56, 2.0F},   // decimals shown by dialogs
    {57, 0.0F},   // text pen
    {93, 0.0F},   // text spacing
};

struct LetterSetting {
  int slot;
  char value;
};
constexpr LetterSetting kLetterSettings[] = {
    {89, ' '},  // text height sign: 'f' makes the height count as negative
    {94, 'm'},  // drawing unit letter: 'm' metres, 'c' centimetres, 'l' millimetres
};

}  // namespace

void ResetArgumentBlocks() {
  std::fill(std::begin(globi), std::end(globi), 0);
  std::fill(std::begin(globr), std::end(globr), 0.0F);
  std::fill(std::begin(globp), std::end(globp), host::Point3f{0.0F, 0.0F, 0.0F});
  std::fill(std::begin(globc), std::end(globc), '\0');
  db.handle = 0;
  for (const FloatSetting& setting : kFloatSettings) globr[setting.slot] = setting.value;
  for (const LetterSetting& setting : kLetterSettings) globc[setting.slot] = setting.value;
}

}  // namespace wb
