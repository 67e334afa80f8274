// Default message handling of a window.
#include "framework/cwnd.h"

LRESULT CWnd::SendMessage(UINT, WPARAM, LPARAM) { return 0; }
