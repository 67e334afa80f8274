// Resource lookup in the loaded library's module, and the icon handles given out for pictures.
#include "framework/resource_module.h"

#include <algorithm>
#include <charconv>
#include <deque>
#include <map>
#include <tuple>
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

// The pictures made for slices of bitmap strips, by (id, index, width).
using SliceKey = std::tuple<UINT, int, int, const char*>;  // and the strip's text, should the module change
std::map<SliceKey, HICON>& Slices() {
  static std::map<SliceKey, HICON> slices;
  return slices;
}

std::deque<std::string>& SliceTexts() {
  static std::deque<std::string> texts;  // a deque: the views into it stay valid as it grows
  return texts;
}

HICON AddIcon(UINT id, std::string_view picture) {
  auto& icons = Icons();
  icons.push_back({id, picture});
  return HICON(static_cast<std::uint32_t>(icons.size()));
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

std::string_view BitmapPicture(HBITMAP bitmap) { return IconPicture(HICON(bitmap.Value())); }
UINT BitmapResourceId(HBITMAP bitmap) { return IconResourceId(HICON(bitmap.Value())); }

SIZE PictureSize(std::string_view svg) {
  const auto start = std::min(svg.find("<svg"), svg.size());
  const auto head = svg.substr(start, svg.find('>', start) - start);
  const auto at = head.find("viewBox=\"");
  if (at == std::string_view::npos) return {16, 16};
  double numbers[4] = {0, 0, 16, 16};
  const char* p = head.data() + at + 9;
  const char* end = head.data() + head.size();
  for (double& n : numbers) {
    while (p < end && (*p == ' ' || *p == ',')) ++p;
    p = std::from_chars(p, end, n).ptr;
  }
  return {static_cast<LONG>(numbers[2]), static_cast<LONG>(numbers[3])};
}

HICON LoadPictureSlice(UINT id, int index, int width) {
  const std::string_view strip = IconPicture(AfxLoadIcon(id));
  const SliceKey key(id, index, width, strip.data());
  if (const auto it = Slices().find(key); it != Slices().end()) return it->second;
  const SIZE size = PictureSize(strip);
  const auto open = strip.find('>', std::min(strip.find("<svg"), strip.size()));
  const auto close = strip.rfind("</svg>");
  if (strip.empty() || width <= 0 || index < 0 || (index + 1) * width > size.cx || open == std::string_view::npos ||
      close == std::string_view::npos || close < open) {
    return HICON();
  }
  // The slice is the strip's drawing seen through a window one image wide.
  std::string text = "<svg xmlns=\"http://www.w3.org/2000/svg\" viewBox=\"" + std::to_string(index * width) + " 0 " +
                     std::to_string(width) + " " + std::to_string(size.cy) + "\">";
  text.append(strip.substr(open + 1, close - open - 1));
  text += "</svg>";
  SliceTexts().push_back(std::move(text));
  const HICON icon = AddIcon(id, SliceTexts().back());
  Slices().emplace(key, icon);
  return icon;
}

}  // namespace framework

HBITMAP AfxLoadBitmap(UINT id) { return HBITMAP(AfxLoadIcon(id).Value()); }

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
  return framework::AddIcon(id, picture);
}

const DialogTemplate* AfxFindDialogTemplate(UINT id) {
  const framework::ResourceModule* module = framework::GetResourceModule();
  if (module == nullptr || module->findDialog == nullptr) return nullptr;
  return module->findDialog(id);
}
