// The drawing's tables inside a SQLite database: written into a new file, read from an opened
// database. Both throw SqliteError or BadContent; the callers name the file in their errors.
#pragma once

#include <cstddef>
#include <filesystem>

#include "workbench/drawing.h"
#include "workbench/drawing_file_sqlite.h"

namespace wb::drawing_file {

// Writes the drawing into the empty file at `path` (absolute) in one transaction.
void WriteDrawingDatabase(const Drawing& drawing, const std::filesystem::path& path);

// SQLite's check of every page: the structure of the file, which the rows do not show.
void CheckPages(const Connection& database);

// Checks the schema and every row, and answers the drawing only when all of it holds together.
// `fileSize` bounds what a forged row count may reserve.
Drawing ReadDrawingDatabase(const Connection& database, std::size_t fileSize);

}  // namespace wb::drawing_file
