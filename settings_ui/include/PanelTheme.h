#pragma once
class wxWindow;

// Gives a settings window the background of the host's "Default" theme.
void ApplyDefaultTheme(wxWindow* window);
