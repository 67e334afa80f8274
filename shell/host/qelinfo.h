// Calls into the host's information library: it tracks whether the manager pane is on.
#pragma once

extern "C" {

void SetCameraManagerOn();
void SetCameraManagerOff();

}  // extern "C"
