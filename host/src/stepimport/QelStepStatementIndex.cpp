#include "QelStepStatementIndex.h"

#include <cctype>
#include <cstdlib>

QelStepStatementIndex::QelStepStatementIndex(std::string_view text) {
  constexpr size_t npos = std::string_view::npos;
  const size_t data = text.find("DATA;");
  size_t i = data == npos ? 0 : data + 5;
  while (i < text.size()) {
    if (text[i] == '\'') {  // a string outside any entity (never in a valid file): skip it
      const size_t close = text.find('\'', i + 1);
      i = close == npos ? text.size() : close + 1;
      continue;
    }
    if (text[i] != '#') {
      ++i;
      continue;
    }
    char* end = nullptr;
    const long id = std::strtol(text.data() + i + 1, &end, 10);
    size_t at = static_cast<size_t>(end - text.data());
    while (at < text.size() && std::isspace(static_cast<unsigned char>(text[at]))) ++at;
    if (at >= text.size() || text[at] != '=') {
      i = at + 1;
      continue;
    }
    const size_t begin = ++at;
    bool quoted = false;
    while (at < text.size() && (quoted || text[at] != ';')) {
      if (text[at] == '\'') quoted = !quoted;
      if (!quoted && text[at] == '#') {
        const long ref = std::strtol(text.data() + at + 1, nullptr, 10);
        auto& list = referrers_[ref];
        if (list.empty() || list.back() != id) list.push_back(id);
      }
      ++at;
    }
    if (statements_.emplace(id, text.substr(begin, at - begin)).second) order_.push_back(id);
    i = at + 1;
  }
}

std::string_view QelStepStatementIndex::At(long id) const {
  auto it = statements_.find(id);
  return it == statements_.end() ? std::string_view() : it->second;
}

const std::vector<long>& QelStepStatementIndex::Referrers(long id) const {
  static const std::vector<long> none;
  auto it = referrers_.find(id);
  return it == referrers_.end() ? none : it->second;
}
