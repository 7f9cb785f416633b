#pragma once
// QelStepDataScan: one pass over a STEP file's bytes before the translator sees them. It
// refuses what no real file holds and what the translator is known to die or stall on
// (parameters nested absurdly deep, statements with absurdly many values or bytes, a list left open, a number
// holding a letter, stray bytes) with the line and entity at fault, and it lists the
// entities of the kinds whose reading the importer checks afterwards. A plain value.
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

class QelStepDataScan {
 public:
  // Real files nest lists a few levels deep (a B-spline surface's weights: three).
  static constexpr size_t kMaxNesting = 32;
  // The translator's reader takes time in the square of a statement's number of values
  // (120,000 take it 10 s); the largest of the shared models holds 27,167.
  static constexpr size_t kMaxStatementValues = 100000;
  static constexpr size_t kMaxStatementBytes = 16u << 20;

  // The kinds of entity whose reading is checked against what the file declares.
  enum class Kind { Datum, Tolerance, Dimension, SavedView, Tessellated };
  struct Declared {
    Kind kind;
    uint64_t id;          // the entity's #number
    std::string type;     // its type keyword (the first one of a complex instance)
    std::string name;     // its first string parameter
    std::string lastText; // its last string parameter (a datum's letter)
  };

  // False with `error` ("line 12, #3571: ...", without the file's name) when the text
  // breaks one of the rules above.
  static bool Scan(std::string_view text, QelStepDataScan& scan, std::string& error);

  const std::vector<Declared>& Entities() const { return declared_; }
  size_t Count(Kind kind) const;

 private:
  std::vector<Declared> declared_;
};
