// Calls into the host's information library: it tracks whether the manager pane is on.
#pragma once

void SetCameraManagerOn();
void SetCameraManagerOff();
