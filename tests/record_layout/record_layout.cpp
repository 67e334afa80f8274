// Prints the widths of pointers and message parameters, then each host record's size and the
// offsets of the fields the host and the plug-in both read.
#include "tests/record_layout/record_layout.h"

#include <cstddef>
#include <cstdint>

#include "framework/win_types.h"
#include "shell/host/argument_blocks.h"
#include "shell/host/host_types.h"
#include "shell/host/qeldll_view.h"

void PrintRecordLayout(std::FILE* out) {
  using namespace host;
  std::fprintf(out, "pointer %zu, size_t %zu, WPARAM %zu, LPARAM %zu, LRESULT %zu\n", sizeof(void*),
               sizeof(std::size_t), sizeof(WPARAM), sizeof(LPARAM), sizeof(LRESULT));
  std::fprintf(out, "DatabaseHandle %zu, EntityHandle %zu, RecordHandle %zu, Status %zu, DbBlock %zu\n",
               sizeof(DatabaseHandle), sizeof(EntityHandle), sizeof(RecordHandle), sizeof(Status), sizeof(DbBlock));
  std::fprintf(out, "globi %zu, globr %zu, globp %zu, globc %zu bytes\n", sizeof globi, sizeof globr, sizeof globp,
               sizeof globc);
  std::fprintf(out, "EntityHeader %zu, Point3f %zu\n", sizeof(EntityHeader), sizeof(Point3f));
  std::fprintf(out, "LineRecord %zu (start @%zu, end @%zu)\n", sizeof(LineRecord), offsetof(LineRecord, start),
               offsetof(LineRecord, end));
  std::fprintf(out, "BlockRecord %zu (flags @%zu), GroupRecord %zu\n", sizeof(BlockRecord),
               offsetof(BlockRecord, flags), sizeof(GroupRecord));
  std::fprintf(out, "PointRecord %zu (position @%zu)\n", sizeof(PointRecord), offsetof(PointRecord, position));
  std::fprintf(out, "PlacedBlockRecord %zu (placement @%zu, block @%zu)\n", sizeof(PlacedBlockRecord),
               offsetof(PlacedBlockRecord, placement), offsetof(PlacedBlockRecord, block));
  std::fprintf(out, "ElementRecord %zu (shortName @%zu, placement @%zu)\n", sizeof(ElementRecord),
               offsetof(ElementRecord, shortName), offsetof(ElementRecord, placement));
  std::fprintf(out, "LayerEntry %zu\n", sizeof(LayerEntry));
}
