// Host calls on placed entities: insertions of blocks and elements placed from a library.
#include <algorithm>
#include <string>
#include <string_view>

#include "shell/host/qeldll.h"
#include "workbench/host_call_support.h"

using namespace wb;

namespace {

template <typename Record>
Status AddPlaced(const char* function, DatabaseHandle database, EntityHandle* newEntity, std::uint8_t type,
                 const Record* record, const char* name) {
  if (auto fault = call::Fault(function)) return call::AsStatus(*fault);
  Drawing* drawing = Workbench::Get().Find(database);
  if (drawing == nullptr || newEntity == nullptr || record == nullptr) return 0;
  Entity& entity = drawing->Add(type);
  WriteRecord(entity, *record);
  if (name != nullptr) entity.name = name;
  *newEntity = entity.handle;
  call::JournalHostCall(function, entity.handle);
  return host::kOk;
}

// The library reference of an element: what the loader recorded when it placed it, otherwise
// the reference the element's own attribute record carries (elements the plug-in places tell
// their library file and folder that way).
std::string LibraryReference(const Entity& element, const std::string& recorded, const char* attributeName) {
  if (!recorded.empty()) return recorded;
  const Attribute* attribute = element.FindAttribute(attributeName);
  return attribute != nullptr && attribute->type == AttributeType::String ? attribute->text : std::string{};
}

}  // namespace

Status qel_read_placed_block(DatabaseHandle database, EntityHandle entity, host::PlacedBlockRecord* placed,
                             char** hostName) {
  if (auto fault = call::Fault(__func__, entity)) return call::AsStatus(*fault);
  const Entity* found = call::FindEntityOfType(database, entity, host::kTypePlacedBlock);
  if (found == nullptr || placed == nullptr) return 0;
  *placed = ReadRecord<host::PlacedBlockRecord>(*found);
  call::HandOutName(*found, hostName);
  return host::kOk;
}

// The flags ask for redraw variants this host does not distinguish.
Status qel_update_placed_block(DatabaseHandle database, EntityHandle entity, const host::PlacedBlockRecord* placed,
                               std::int32_t /*flags*/) {
  return call::UpdateTypedRecord(__func__, database, entity, host::kTypePlacedBlock, placed);
}

Status qel_add_placed_block(DatabaseHandle database, EntityHandle* newEntity, const char* name,
                            const host::PlacedBlockRecord* placed) {
  return AddPlaced(__func__, database, newEntity, host::kTypePlacedBlock, placed, name);
}

Status qel_read_element(DatabaseHandle database, EntityHandle entity, host::ElementRecord* element) {
  return call::ReadTypedRecord(__func__, database, entity, host::kTypeElement, element);
}

Status qel_update_element(DatabaseHandle database, EntityHandle entity, const host::ElementRecord* element) {
  return call::UpdateTypedRecord(__func__, database, entity, host::kTypeElement, element);
}

Status qel_add_element(DatabaseHandle database, EntityHandle* newEntity, const host::ElementRecord* element,
                       std::int32_t /*flags*/) {
  return AddPlaced(__func__, database, newEntity, host::kTypeElement, element, nullptr);
}

char* qel_get_config_path(DatabaseHandle database, EntityHandle entity) {
  if (call::Fault(__func__, entity)) return nullptr;
  const Entity* element = call::FindEntityOfType(database, entity, host::kTypeElement);
  if (element == nullptr) return nullptr;
  return Workbench::Get().Memory().DuplicateText(LibraryReference(*element, element->configPath, "URL="));
}

// The element's name; failing a recorded one, its library file, and failing that the short
// name it is filed under.
char* qel_get_element_name(DatabaseHandle database, EntityHandle entity, const char* shortName) {
  if (call::Fault(__func__, entity)) return nullptr;
  const Entity* element = call::FindEntityOfType(database, entity, host::kTypeElement);
  if (element == nullptr) return nullptr;
  std::string name = LibraryReference(*element, element->elementName, "@lfname=");
  if (name.empty() && shortName != nullptr) name.assign(shortName, std::find(shortName, shortName + 8, '\0'));
  return Workbench::Get().Memory().DuplicateText(name);
}

const char* qel_get_short_name(const char* fileName, char* buffer) {
  if (call::Fault(__func__) || buffer == nullptr) {
    if (buffer != nullptr) buffer[0] = '\0';
    return nullptr;
  }
  std::string_view name = fileName == nullptr ? std::string_view{} : std::string_view{fileName};
  if (const auto folderEnd = name.find_last_of("\\/"); folderEnd != std::string_view::npos) {
    name.remove_prefix(folderEnd + 1);
  }
  if (const auto extension = name.rfind('.'); extension != std::string_view::npos && extension > 0) {
    name = name.substr(0, extension);
  }
  std::size_t length = std::min<std::size_t>(name.size(), 8);
  // Never cut a multi-byte character in two.
  if (length < name.size()) {
    while (length > 0 && (static_cast<unsigned char>(name[length]) & 0xC0) == 0x80) --length;
  }
  std::copy_n(name.data(), length, buffer);
  buffer[length] = '\0';
  return buffer;
}
