// Resource lookup in the loaded library's module, and the icon handles given out for pictures.
#include "framework/resource_module.h"

#include <map>
#include <vector>

#include "framework/system_icons.h"
#include "framework/win_constants.h"

namespace framework {
namespace {

const ResourceModule* currentModule = nullptr;

struct LoadedIcon {
  UINT id = 0;
  std::string_view picture;
};

// Icons stay loaded for the life of the process, like shared icons: handles are never freed.
std::vector<LoadedIcon>& Icons() {
  static std::vector<LoadedIcon> icons;
  return icons;
}

const LoadedIcon* FindIcon(HICON icon) {
  const std::uint32_t index = icon.Value();
  if (index == 0 || index > Icons().size()) return nullptr;
  return &Icons()[index - 1];
}

}  // namespace

void SetResourceModule(const ResourceModule* module) { currentModule = module; }
const ResourceModule* GetResourceModule() { return currentModule; }

std::string_view ApplicationName() {
  return currentModule != nullptr && !currentModule->name.empty() ? currentModule->name : "Application";
}

std::string_view IconPicture(HICON icon) {
  const LoadedIcon* loaded = FindIcon(icon);
  return loaded != nullptr ? loaded->picture : std::string_view();
}

UINT IconResourceId(HICON icon) {
  const LoadedIcon* loaded = FindIcon(icon);
  return loaded != nullptr ? loaded->id : 0;
}

}  // namespace framework

std::string AfxLoadString(UINT id) {
  const framework::ResourceModule* module = framework::GetResourceModule();
  if (module == nullptr || module->loadString == nullptr) return {};
  return std::string(module->loadString(id));
}

HICON AfxLoadIcon(UINT id) {
  std::string_view picture = framework::SystemIconPicture(id);
  const framework::ResourceModule* module = framework::GetResourceModule();
  if (picture.empty() && module != nullptr && module->findPicture != nullptr) picture = module->findPicture(id);
  if (picture.empty()) return HICON();
  auto& icons = framework::Icons();
  for (std::size_t i = 0; i < icons.size(); ++i) {
    if (icons[i].id == id && icons[i].picture.data() == picture.data()) return HICON(static_cast<std::uint32_t>(i + 1));
  }
  icons.push_back({id, picture});
  return HICON(static_cast<std::uint32_t>(icons.size()));
}

const DialogTemplate* AfxFindDialogTemplate(UINT id) {
  const framework::ResourceModule* module = framework::GetResourceModule();
  if (module == nullptr || module->findDialog == nullptr) return nullptr;
  return module->findDialog(id);
}
