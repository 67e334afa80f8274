// The resource module handed to the UI framework when the library loads.
#include "resources/resource_module.h"

#include "resources/dialog_templates.h"
#include "resources/string_table.h"

namespace resources {

const framework::ResourceModule& Module() {
  static const framework::ResourceModule module{
      "Pandex",
      [](UINT id) { return LoadString(static_cast<int>(id)); },
      &FindDialogTemplate,
      &FindPicture,
  };
  return module;
}

}  // namespace resources
