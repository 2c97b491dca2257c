#pragma once

#include "Runtime/Utilities/ConsoleLog.h"

/// Keeps from the console what a test body prints: refuses every message while the current run's reporter has
/// a test in progress, and lets through all others, among them the reporter's own. Several callers wait for
/// each other.
bool LogEntryHandlerForTests(LogType type, const char* format, std::va_list arguments);
