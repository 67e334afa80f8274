// The library's resources as the UI framework finds them: strings, dialog templates, pictures.
#pragma once

#include "framework/resource_module.h"

namespace resources {

const framework::ResourceModule& Module();

// The SVG picture of an icon or bitmap id (the files of icons/, built in); empty for none.
std::string_view FindPicture(UINT id);

}  // namespace resources
