// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class AppContext;

// The first step of start-up: derives the program's paths, reads and checks the connection
// settings into the context's settings record and makes sure the main database file exists,
// creating it from the template on first use. Returns the message that stops start-up, or
// empty text when the program may go on.
QString loadSettings(AppContext &context);
