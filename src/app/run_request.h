#pragma once
// What the program does with one parsed command line, with or without windows.

#include <QString>
#include <cstdio>

#include "startup/command_line.h"

namespace zv {

// Files the request once Main has passed it; returns the archived path, empty when nothing
// was filed.
using FilingHandler = QString (*)(const CommandLine& cl, int mode, const QString& path,
                                  const QString& name);

// The program's arguments after its name.
QList<QByteArray> ProgramArguments(int argc, char** argv);

void Print(std::FILE* stream, const QString& text);

// Answers --help and --version; returns whether the run ends here.
bool AnswerInformation(const CommandLine& cl, const char* program);

// Runs the request through Main and returns the exit status: 0 done (with --batch the
// archived path is printed), 1 refused or not filed, 2 a usage error.
int RunRequest(const CommandLine& cl, const char* program, FilingHandler file);

}  // namespace zv
