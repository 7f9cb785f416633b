#pragma once
// QelModelJsonReader: the first pass of the model loader over a model file's text. It
// builds a JSON tree of everything but the elements of each set's annotations, views and
// captures, of which it keeps only the byte ranges, so that the loader can parse each on
// its own and the whole document never sits in memory as one tree (many times the text).
// The ranges point into the text, which must outlive them.
#include <array>
#include <cstddef>
#include <string>
#include <vector>

#include <nlohmann/json.hpp>

class QelModelJsonReader {
 public:
  // Containers inside containers, the document itself being level 1. The loader walks the
  // tree recursively, so the stack bounds what a file may nest.
  static constexpr size_t kMaxNesting = 512;
  // Products below the root; each takes two levels of nesting (children array and object).
  static constexpr int kMaxProductDepth = 200;
  static constexpr std::array<const char*, 3> kListKeys = {"annotations", "views", "captures"};

  struct Range {
    size_t begin;
    size_t end;
  };
  // The elements of the lists of one element of "sets", in the order of kListKeys.
  struct SetLists {
    std::vector<Range> lists[3];
  };

  // Fills `doc` and `sets` (indexed like the document's "sets"). Throws
  // nlohmann::json::parse_error on a syntax error, and std::runtime_error with the message
  // "<JSON path>: <what is wrong>" on nesting beyond the limits, a number out of range or
  // an element of a set's list that is not an object.
  static void Read(const std::string& text, nlohmann::json& doc, std::vector<SetLists>& sets);
};
