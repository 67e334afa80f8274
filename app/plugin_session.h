// A drawing opened in the workbench with the plug-in loaded, for one command of the program.
#pragma once

#include "workbench/drawing.h"

namespace app {

class PluginSession {
 public:
  explicit PluginSession(wb::Drawing drawing);
  ~PluginSession();
  PluginSession(const PluginSession&) = delete;
  PluginSession& operator=(const PluginSession&) = delete;

  // The drawing as the plug-in has left it so far.
  const wb::Drawing& Drawing() const;
};

}  // namespace app
