#include "QelStepDataScan.h"

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <unordered_map>

namespace {
using Kind = QelStepDataScan::Kind;

const std::unordered_map<std::string_view, Kind>& KindsByType() {
  static const std::unordered_map<std::string_view, Kind> kinds = {
      {"DATUM", Kind::Datum},
      {"GEOMETRIC_TOLERANCE", Kind::Tolerance},
      {"ANGULARITY_TOLERANCE", Kind::Tolerance},
      {"CIRCULAR_RUNOUT_TOLERANCE", Kind::Tolerance},
      {"COAXIALITY_TOLERANCE", Kind::Tolerance},
      {"CONCENTRICITY_TOLERANCE", Kind::Tolerance},
      {"CYLINDRICITY_TOLERANCE", Kind::Tolerance},
      {"FLATNESS_TOLERANCE", Kind::Tolerance},
      {"LINE_PROFILE_TOLERANCE", Kind::Tolerance},
      {"PARALLELISM_TOLERANCE", Kind::Tolerance},
      {"PERPENDICULARITY_TOLERANCE", Kind::Tolerance},
      {"POSITION_TOLERANCE", Kind::Tolerance},
      {"ROUNDNESS_TOLERANCE", Kind::Tolerance},
      {"STRAIGHTNESS_TOLERANCE", Kind::Tolerance},
      {"SURFACE_PROFILE_TOLERANCE", Kind::Tolerance},
      {"SYMMETRY_TOLERANCE", Kind::Tolerance},
      {"TOTAL_RUNOUT_TOLERANCE", Kind::Tolerance},
      {"DIMENSIONAL_SIZE", Kind::Dimension},
      {"DIMENSIONAL_LOCATION", Kind::Dimension},
      {"ANGULAR_SIZE", Kind::Dimension},
      {"ANGULAR_LOCATION", Kind::Dimension},
      {"DIMENSIONAL_SIZE_WITH_PATH", Kind::Dimension},
      {"DIMENSIONAL_LOCATION_WITH_PATH", Kind::Dimension},
      {"DIMENSIONAL_SIZE_WITH_DATUM_FEATURE", Kind::Dimension},
      {"CAMERA_MODEL_D3", Kind::SavedView},
      {"CAMERA_MODEL_D3_MULTI_CLIPPING", Kind::SavedView},
      {"CAMERA_MODEL_D3_WITH_HLHSR", Kind::SavedView},
      // Tessellated shapes of parts; the surface sets of annotation presentations are not among them.
      {"COMPLEX_TRIANGULATED_FACE", Kind::Tessellated},
      {"TRIANGULATED_FACE", Kind::Tessellated},
      {"TESSELLATED_SHELL", Kind::Tessellated},
      {"TESSELLATED_SOLID", Kind::Tessellated},
  };
  return kinds;
}

bool IsLetter(unsigned char c) { return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_'; }
bool IsDigit(unsigned char c) { return c >= '0' && c <= '9'; }
bool IsWordChar(unsigned char c) { return IsLetter(c) || IsDigit(c) || c == '-'; }

std::string Unquoted(std::string_view quoted) {
  std::string out;
  for (size_t i = 1; i + 1 < quoted.size(); ++i) {
    out += quoted[i];
    if (quoted[i] == '\'') ++i;
  }
  return out;
}

// One pass over the text, token by token; a refusal names the line and the entity of the
// statement it stands in.
class Scanner {
 public:
  Scanner(std::string_view text, std::vector<QelStepDataScan::Declared>& declared) : text_(text), declared_(declared) {}

  bool Run(std::string& error) {
    const size_t n = text_.size();
    size_t i = 0;
    while (i < n) {
      const unsigned char c = static_cast<unsigned char>(text_[i]);
      if (c <= ' ') {
        ++i;
        continue;
      }
      if (c == '\'') {
        const size_t start = i;
        for (++i;; ++i) {
          if (i >= n) return Fail(start, "a string is not closed", error);
          if (text_[i] == '\'') {
            if (i + 1 < n && text_[i + 1] == '\'') {
              ++i;
              continue;
            }
            break;
          }
        }
        ++i;
        Token(start);
        if (!firstString_.data()) firstString_ = text_.substr(start, i - start);
        lastString_ = text_.substr(start, i - start);
        continue;
      }
      if (c >= 0x80) return Fail(i, "a byte that no STEP file holds outside a string", error, c);
      if (IsDigit(c) || c == '+' || c == '-') {
        const size_t start = i;
        if (!Number(i)) return Fail(start, "a malformed number '" + Word(start) + "'", error);
        Token(start);
        continue;
      }
      if (IsLetter(c) || c == '!') {
        const size_t start = i;
        for (++i; i < n && IsWordChar(static_cast<unsigned char>(text_[i])); ++i) {
        }
        Token(start);
        Keyword(text_.substr(start, i - start));
        continue;
      }
      switch (c) {
        case '#': {
          const size_t start = i;
          uint64_t id = 0;
          for (++i; i < n && IsDigit(static_cast<unsigned char>(text_[i])); ++i) {
            if (id > (UINT64_MAX - 9) / 10) return Fail(start, "an entity number out of range", error);
            id = id * 10 + static_cast<uint64_t>(text_[i] - '0');
          }
          if (i == start + 1) return Fail(start, "'#' without an entity number", error);
          if (i < n && IsLetter(static_cast<unsigned char>(text_[i]))) {
            return Fail(start, "a malformed entity number '" + Word(start) + "'", error);
          }
          if (!tokenSeen_) {
            id_ = id;
            naming_ = true;
            defined_.push_back(id);
          } else {
            references_.push_back({id, begin_, id_});
          }
          Token(start);
          continue;
        }
        case '.': {
          const size_t start = i;
          for (++i; i < n && (IsWordChar(static_cast<unsigned char>(text_[i]))); ++i) {
          }
          if (i == start + 1 || i >= n || text_[i] != '.') {
            return Fail(start, "a malformed enumeration '" + Word(start) + "'", error);
          }
          ++i;
          Token(start);
          continue;
        }
        case '"': {
          const size_t start = i;
          for (++i; i < n && text_[i] != '"'; ++i) {
            if (!std::isxdigit(static_cast<unsigned char>(text_[i]))) return Fail(start, "a malformed binary value", error);
          }
          if (i >= n) return Fail(start, "a binary value is not closed", error);
          ++i;
          Token(start);
          continue;
        }
        case '/': {
          if (i + 1 >= n || text_[i + 1] != '*') return Fail(i, "a stray '/'", error);
          const size_t end = text_.find("*/", i + 2);
          if (end == std::string_view::npos) return Fail(i, "a comment is not closed", error);
          i = end + 2;
          continue;
        }
        case '(':
          if (afterEquals_) complex_ = true;
          Token(i);
          if (++depth_ > QelStepDataScan::kMaxNesting) {
            return Fail(i, "parameters nested more than " + std::to_string(QelStepDataScan::kMaxNesting) + " levels deep",
                        error);
          }
          ++i;
          continue;
        case ')':
          Token(i);
          if (depth_ == 0) return Fail(i, "a ')' closes no list", error);
          --depth_;
          ++i;
          continue;
        case ',':
          Token(i);
          if (depth_ == 0) return Fail(i, "a ',' outside any list", error);
          if (++values_ >= QelStepDataScan::kMaxStatementValues) {
            return Fail(i, "a statement of more than " + std::to_string(QelStepDataScan::kMaxStatementValues) + " values",
                        error);
          }
          ++i;
          continue;
        case ';':
          if (depth_ != 0) return Fail(i, "the statement ends inside a list (a ')' is missing)", error);
          if (i - statement_ > QelStepDataScan::kMaxStatementBytes) {
            return Fail(begin_, "a statement longer than " +
                                        std::to_string(QelStepDataScan::kMaxStatementBytes >> 20) + " MB", error);
          }
          EndStatement();
          ++i;
          statement_ = i;
          continue;
        case '=':
          Token(i);
          afterEquals_ = naming_;
          ++i;
          continue;
        case '$':
        case '*':
        case '&':
          Token(i);
          ++i;
          continue;
        default:
          return Fail(i, "an unexpected character", error, c);
      }
    }
    if (depth_ != 0) return Fail(begin_, "the file ends inside a list", error);
    return CheckReferences(error);
  }

 private:
  // Every token but '=' and '(' ends the wait for a complex instance's opening.
  void Token(size_t at) {
    if (!tokenSeen_) begin_ = at;
    tokenSeen_ = true;
    afterEquals_ = false;
  }

  void Keyword(std::string_view word) {
    // A simple instance's type stands before its list, a complex one's types inside it.
    if (depth_ != (complex_ ? 1u : 0u)) return;
    if (keywords_.size() < 16) keywords_.push_back(word);
  }

  bool Number(size_t& i) {
    const size_t n = text_.size();
    if (text_[i] == '+' || text_[i] == '-') ++i;
    const size_t digits = i;
    while (i < n && IsDigit(static_cast<unsigned char>(text_[i]))) ++i;
    if (i == digits) return false;
    if (i < n && text_[i] == '.') {
      ++i;
      while (i < n && IsDigit(static_cast<unsigned char>(text_[i]))) ++i;
    }
    if (i < n && (text_[i] == 'E' || text_[i] == 'e')) {
      ++i;
      if (i < n && (text_[i] == '+' || text_[i] == '-')) ++i;
      const size_t exponent = i;
      while (i < n && IsDigit(static_cast<unsigned char>(text_[i]))) ++i;
      if (i == exponent) return false;
    }
    // A number ends at a separator: a letter, point or quote glued to it is damage.
    return i >= n || !(IsWordChar(static_cast<unsigned char>(text_[i])) || text_[i] == '.' || text_[i] == '\'' ||
                       text_[i] == '#');
  }

  // A reference to an entity the file does not define is damage (a file cut short and its
  // end put back, a number hit by a flipped byte); the translator would drop what holds it.
  bool CheckReferences(std::string& error) {
    std::sort(defined_.begin(), defined_.end());
    for (const Reference& r : references_) {
      if (std::binary_search(defined_.begin(), defined_.end(), r.id)) continue;
      naming_ = r.from != 0;
      id_ = r.from;
      return Fail(r.statement, "refers to #" + std::to_string(r.id) + ", which the file does not define", error);
    }
    return true;
  }

  std::string Word(size_t start) const {
    size_t end = start + 1;
    while (end < text_.size() && end - start < 24 && !std::isspace(static_cast<unsigned char>(text_[end])) &&
           text_[end] != ',' && text_[end] != ')' && text_[end] != ';')
      ++end;
    return std::string(text_.substr(start, end - start));
  }

  void EndStatement() {
    for (std::string_view word : keywords_) {
      auto it = KindsByType().find(word);
      if (it == KindsByType().end()) continue;
      declared_.push_back({it->second, id_, std::string(keywords_.front()),
                           firstString_.data() ? Unquoted(firstString_) : std::string(),
                           lastString_.data() ? Unquoted(lastString_) : std::string()});
      break;
    }
    keywords_.clear();
    firstString_ = {};
    lastString_ = {};
    id_ = 0;
    values_ = 0;
    naming_ = tokenSeen_ = afterEquals_ = complex_ = false;
  }

  bool Fail(size_t at, const std::string& what, std::string& error, int byte = -1) const {
    const size_t line = 1 + static_cast<size_t>(std::count(text_.begin(), text_.begin() + static_cast<std::ptrdiff_t>(at), '\n'));
    error = "line " + std::to_string(line);
    if (naming_) error += ", #" + std::to_string(id_);
    error += ": " + what;
    if (byte >= 0) {
      char code[16];
      std::snprintf(code, sizeof code, " (byte 0x%02X)", byte);
      error += code;
    }
    return false;
  }

  struct Reference {
    uint64_t id;
    size_t statement;  // where the statement holding it begins
    uint64_t from;     // that statement's entity, 0 for none
  };

  std::string_view text_;
  std::vector<QelStepDataScan::Declared>& declared_;
  std::vector<uint64_t> defined_;
  std::vector<Reference> references_;
  std::vector<std::string_view> keywords_;
  std::string_view firstString_, lastString_;
  size_t depth_ = 0;
  size_t values_ = 0;  // separators in the statement so far
  size_t statement_ = 0;  // where the statement's text begins (after the last ';')
  size_t begin_ = 0;      // where its first token stands
  uint64_t id_ = 0;
  bool naming_ = false;       // the statement began with its #number
  bool tokenSeen_ = false;    // the statement has a token already
  bool afterEquals_ = false;  // just after "#n=": a '(' opens a complex instance
  bool complex_ = false;
};
}  // namespace

bool QelStepDataScan::Scan(std::string_view text, QelStepDataScan& scan, std::string& error) {
  scan.declared_.clear();
  error.clear();
  return Scanner(text, scan.declared_).Run(error);
}

size_t QelStepDataScan::Count(Kind kind) const {
  return static_cast<size_t>(
      std::count_if(declared_.begin(), declared_.end(), [kind](const Declared& d) { return d.kind == kind; }));
}
