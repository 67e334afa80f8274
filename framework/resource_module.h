// The resources of the loaded library: its texts, dialog templates and pictures, found by id.
#pragma once

#include <string>
#include <string_view>

#include "framework/win_types.h"

struct DialogTemplate;

namespace framework {

// What a library hands the framework so that its windows can find their resources; the
// functions answer empty or null for an id the library does not have.
struct ResourceModule {
  std::string_view name;  // the library's name, the caption of its plain message boxes
  std::string_view (*loadString)(UINT id) = nullptr;
  const DialogTemplate* (*findDialog)(UINT id) = nullptr;
  // An icon or bitmap as an SVG picture (one image of a bitmap strip is a slice of it).
  std::string_view (*findPicture)(UINT id) = nullptr;
};

// The module resources are looked up in; the loaded library sets it, null forgets it.
void SetResourceModule(const ResourceModule* module);
const ResourceModule* GetResourceModule();

// The application's name for message-box captions: the resource module's, else "Application".
std::string_view ApplicationName();

// The SVG picture behind an icon handle (empty for none).
std::string_view IconPicture(HICON icon);
// The id an icon was loaded by (0 for none), so that renders and tests can say which icon shows.
UINT IconResourceId(HICON icon);

}  // namespace framework

// The text of a string id of the resource module; empty when there is none.
std::string AfxLoadString(UINT id);
// The icon of a resource id (or one of the system's IDI_ icons); the same id gives the same
// handle. A null handle when the picture does not exist.
HICON AfxLoadIcon(UINT id);
const DialogTemplate* AfxFindDialogTemplate(UINT id);
