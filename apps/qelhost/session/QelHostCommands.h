#pragma once
// qelhost's command language: one command per line, a word and its arguments, blanks
// between them, double quotes around an argument with blanks ("Annotation Types/By kind").
// The table lists every command; a new command is one more entry.
#include <string>
#include <vector>

class QelHostSession;

struct QelHostCommand {
  const char* name;
  const char* arguments;  // as help shows them
  const char* summary;
  // False with `error` (the reason) when the command cannot be done.
  bool (*run)(QelHostSession& session, const std::vector<std::string>& args, std::string& error);
};

// The commands, in the order help lists them.
std::vector<QelHostCommand>& QelHostCommandTable();

// Splits a line into words; false with `error` for an unterminated quote.
bool QelHostSplitLine(const std::string& line, std::vector<std::string>& words, std::string& error);
