// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <optional>

// Makes a database file from a SQL script, as the build makes the template new.db. The file
// appears only when the whole script ran; on failure the result says why.
std::optional<QString> createDatabaseFromScript(const QString &scriptFile,
                                                const QString &databaseFile);
