// Making one 2D drawing file from the view on screen through the host's own 2D commands.
#pragma once

#include <cstdint>
#include <string>

namespace HRUtility {

// Preserve options name entities carried into the 2D drawing unchanged: walls (category 0),
// dimensions (1), texts (2) and one layer. Answers false when the registered file is locked
// (then nothing is done) or when the host could not write it.
bool Save2D(const std::string& target, std::uint8_t autoClip, std::uint8_t overwrite, std::uint8_t removeCoincident,
            std::uint8_t lineMerge, std::uint8_t preserveDimensions, std::uint8_t preserveText,
            std::uint8_t preserveWalls, std::uint8_t preserveLayer, std::int16_t preserveLayerIndex);

// The steps of Save2D, exposed for the batch and for tests.
void ClearSelection();
void SelectPreserved(bool dimensions, bool texts, bool walls, bool layerWanted, std::int32_t layerNumber);
void ExtractSelection();
void BlankForGeneration();
bool IsTargetFree(const char* fileName);
void SetLineCleanup(std::uint8_t removeCoincident, std::uint8_t lineMerge);
void RestoreLineCleanup();
void ExtractInto2D();
void SetRewriteSwitch(std::int32_t value);
void RestoreRewriteSwitch();
void UnblankAfterGeneration();

// The category of an entity from the two codes the database loop reports (bytes 3 and 1);
// -1 when it has none. 0 walls, 1 dimensions, 2 texts.
std::int32_t PreserveCategory(std::uint8_t kind, std::uint8_t code);

}  // namespace HRUtility
