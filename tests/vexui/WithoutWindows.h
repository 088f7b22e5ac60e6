#pragma once

/// The argument with which the test program runs as one that shows no windows.
inline constexpr const char* WITHOUT_WINDOWS = "--without-windows";

/// Runs the four commands as a person does, in a process without Qt's application, and writes what
/// is printed and what is shown in messages.
/// @return how many of them did not fail
int runWithoutWindows();
