// The ui-gallery command: pictures of every control and every dialog template, for a person to
// look at.
#pragma once

namespace CLI {
class App;
}

namespace app {

// Adds "ui-gallery DIR" to the command line; it runs as soon as it is parsed.
void AddUiGalleryCommand(CLI::App& app);

}  // namespace app
