// The one manager pane of the process: created on first need, then hidden and shown.
#pragma once

#include <functional>
#include <memory>

class CPandexDlg;

namespace pandex {

// The pane, or null before the first sub-command that needs it.
CPandexDlg* GetPane();

// Creates the pane when there is none yet and answers it (null when it cannot be had).
CPandexDlg* EnsurePane();

// Makes the panes; the host's load installs the real pane, tests install their own.
using PaneFactory = std::function<std::unique_ptr<CPandexDlg>()>;
void SetPaneFactory(PaneFactory factory);

// A pane whose window was destroyed (its frame closed) deletes itself through this, after its
// last message; the pointer is cleared, so the next sub-command that needs a pane makes one.
void ReleasePane(CPandexDlg* pane);

// Unloading releases the pane with the rest of the library's state.
void DestroyPane();

}  // namespace pandex
