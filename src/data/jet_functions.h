#pragma once
// The Jet functions the suite's SQL texts use, as SQLite functions: Val() and Jet's LIKE
// ("*" any run, "?" one character, "#" one digit, "[abc]", "[a-z]", "[!abc]"; case does
// not matter).

#include <QString>

struct sqlite3;

namespace zv {

// Registers Val(x) and like(pattern, text[, escape]) on a connection. Returns an SQLite
// result code.
int RegisterJetFunctions(sqlite3* db);

// The leading number of a text as Jet's Val reads it: blanks are skipped anywhere, "&H"
// and "&O" read hexadecimal and octal, reading stops at the first other character.
double JetVal(const QString& text);

// Whether text matches a Jet LIKE pattern. escape, when not null, makes the character
// after it literal.
bool JetLike(const QString& pattern, const QString& text, QChar escape = QChar());

}  // namespace zv
