// The ui-gallery command: pictures of every control and every dialog template, for a person to
// look at.
#pragma once

#include <ostream>

namespace CLI {
class App;
}

namespace app {

// Adds "ui-gallery DIR" to the command line and answers its subcommand.
CLI::App* AddUiGalleryCommand(CLI::App& app);
// Writes the pictures into DIR and lists them on `out`; throws when the folder cannot be written.
int RunUiGallery(const CLI::App& command, std::ostream& out);

}  // namespace app
