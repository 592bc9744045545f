#pragma once

#include <QString>

class DemoWindow;

// Works the screen as a user would (clicks, typing, Tab), prints what the report receives
// from each control, and saves a screenshot. Returns the process exit status.
int runScriptedSession(DemoWindow& window, const QString& screenshot);
