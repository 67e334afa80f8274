// The numbers of the host's registered window messages, registered by name when the library
// loads, for the pane's message map and its question to the host.
#pragma once

#include "framework/win_types.h"

namespace pandex {

extern UINT getPaneManagerMessage;  // "Quorvel_GetPaneManager"
extern UINT preTranslateMessage;    // "Quorvel_PreTranslateMessage"

void RegisterHostMessages();

}  // namespace pandex
