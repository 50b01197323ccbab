#pragma once

#include <QString>

namespace zorbin {

// What a database file named by connection type 3 holds, recognised by its content (the name's
// extension says nothing: earlier versions wrote any name the user typed).
enum class DatabaseFileKind {
    Missing, // no such file, or it cannot be read
    Jet,     // a Jet (.mdb) or Access 2007+ (.accdb) file: "Standard Jet DB" or "Standard ACE DB" at byte 4
    Sqlite,  // a SQLite 3 file
    Other,   // anything else
};

DatabaseFileKind databaseFileKind(const QString &path);

} // namespace zorbin
