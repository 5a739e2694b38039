// The setup dialog (resource IDD_SETUP), in which the author edits the
// object's settings.
#pragma once

#include <windows.h>

struct EditData;
struct EditorHost;

// What the caller of the dialog hands to it, alive in the caller's storage
// for as long as the modal dialog runs.
struct SetupDialogContext {
  EditData* edit;    // shown, and overwritten on OK
  EditorHost* host;  // carried along
};

INT_PTR CALLBACK SetupDialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) noexcept;

// Shows the dialog over `edit`, owned by the host's owner window, and waits
// for it: 0 after OK, -1 after Cancel or when the dialog cannot be shown.
INT_PTR RunSetupDialog(EditorHost* host, EditData* edit) noexcept;
