// MsgBox: a modal message with one text. Tests replace the dialog with a reader.
#pragma once

#include <functional>
#include <string>

void MsgBox(const std::string& text);

// While set, MsgBox hands its text here instead of showing a dialog.
void SetMsgBoxHandlerForTesting(std::function<void(const std::string&)> handler);
