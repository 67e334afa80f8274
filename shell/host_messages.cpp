// Registration of the host's window messages.
#include "shell/host_messages.h"

#include "framework/message_queue.h"
#include "shell/host/pane_manager.h"

namespace pandex {

UINT getPaneManagerMessage = 0;
UINT preTranslateMessage = 0;

void RegisterHostMessages() {
  getPaneManagerMessage = ::RegisterWindowMessage(host::kGetPaneManagerMessageName);
  preTranslateMessage = ::RegisterWindowMessage(host::kPreTranslateMessageName);
}

}  // namespace pandex
