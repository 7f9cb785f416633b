#include "QelModelJsonReader.h"

#include <iterator>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace {
using Json = nlohmann::json;
using Lists = std::vector<QelModelJsonReader::SetLists>;
constexpr size_t kMaxNesting = QelModelJsonReader::kMaxNesting;
constexpr int kMaxProductDepth = QelModelJsonReader::kMaxProductDepth;

std::runtime_error Refusal(const std::string& path, const std::string& what) {
  return std::runtime_error(path + ": " + what);
}

// Hands the text to the parser one character at a time and leaves the position where the
// reader can see it: the parser reports no offsets, and the reader needs them to find an
// element of a set's lists again.
class TrackedChars {
 public:
  using iterator_category = std::input_iterator_tag;
  using value_type = char;
  using difference_type = std::ptrdiff_t;
  using pointer = const char*;
  using reference = const char&;

  TrackedChars(const char* at, const char** seen) : at_(at), seen_(seen) {}
  reference operator*() const { return *at_; }
  TrackedChars& operator++() {
    *seen_ = ++at_;
    return *this;
  }
  TrackedChars operator++(int) {
    TrackedChars before = *this;
    ++*this;
    return before;
  }
  bool operator==(const TrackedChars& other) const { return at_ == other.at_; }
  bool operator!=(const TrackedChars& other) const { return at_ != other.at_; }

 private:
  const char* at_;
  const char** seen_;
};

// The handler of the parser's SAX events; it keeps the path of the value being read for
// messages, and where the value goes in the tree.
class Reader {
 public:
  Reader(const std::string& text, Json& doc, Lists& sets) : text_(text), doc_(doc), sets_(sets) {}

  void Read() {
    const char* begin = text_.data();
    const char* end = begin + text_.size();
    seen_ = begin;
    Json::sax_parse(TrackedChars(begin, &seen_), TrackedChars(end, &seen_), this);
  }

  bool null() { return Scalar(nullptr, "null"); }
  bool boolean(bool value) { return Scalar(value, "boolean"); }
  bool number_integer(Json::number_integer_t value) { return Scalar(value, "number"); }
  bool number_unsigned(Json::number_unsigned_t value) { return Scalar(value, "number"); }
  bool number_float(Json::number_float_t value, const std::string&) { return Scalar(value, "number"); }
  bool string(std::string& value) { return Scalar(std::move(value), "string"); }
  bool binary(Json::binary_t&) { return Scalar(nullptr, "binary"); }

  bool start_object(size_t) {
    Frame frame = Open("object");
    if (!frame.value && frames_.size() == 4 && ListOfParent() >= 0) {
      // The first character of an element of a set's list; the parser has just read it.
      divertedAt_ = static_cast<size_t>(seen_ - text_.data()) - 1;
      if (text_[divertedAt_] != '{') throw std::logic_error("the reader lost its place in the text");
    }
    frame.product = ProductDepth();
    frames_.push_back(std::move(frame));
    return true;
  }

  bool key(std::string& key) {
    frames_.back().key = key;
    return true;
  }

  bool end_object() {
    if (frames_.size() == 5 && frames_[3].list >= 0) {
      const Frame& list = frames_[3];
      sets_[list.set].lists[list.list].push_back({divertedAt_, static_cast<size_t>(seen_ - text_.data())});
    }
    Close();
    return true;
  }

  bool start_array(size_t) {
    Frame frame = Open("array");
    frame.array = true;
    if (frames_.size() == 1 && !frames_[0].array && frames_[0].key == "sets") sets_.clear();
    if (frame.value && frames_.size() == 3 && frames_[0].key == "sets" && frames_[1].array && !frames_[2].array) {
      for (int k = 0; k < 3; ++k) {
        if (frames_[2].key != QelModelJsonReader::kListKeys[k]) continue;
        frame.list = k;
        frame.set = frames_[1].next;
        if (sets_.size() <= frame.set) sets_.resize(frame.set + 1);
        sets_[frame.set].lists[k].clear();
      }
    }
    frames_.push_back(std::move(frame));
    return true;
  }

  bool end_array() {
    Close();
    return true;
  }

  bool parse_error(size_t, const std::string& token, const nlohmann::detail::exception& e) {
    if (e.id == 406) throw Refusal(Path(), "number out of range: " + token);
    if (auto* syntax = dynamic_cast<const Json::parse_error*>(&e)) throw *syntax;
    throw std::runtime_error(e.what());
  }

 private:
  struct Frame {
    Json* value = nullptr;  // null inside an element of a set's list
    bool array = false;
    size_t next = 0;        // arrays: index of the element being read
    std::string key;        // objects: key of the value being read
    int product = -1;       // objects: depth of a product below the root
    int list = -1;          // a set's list: which one, and of which set
    size_t set = 0;
  };

  // The place of the value being read, as the loader's messages write it.
  std::string Path() const {
    std::string path = "$";
    for (const Frame& f : frames_) path += f.array ? "[" + std::to_string(f.next) + "]" : "." + f.key;
    return path;
  }

  int ListOfParent() const { return frames_.back().array ? frames_.back().list : -1; }

  // Where the next value goes: the document, an array or an object's current key; null
  // inside an element of a set's list, which is read again later on its own.
  Json* Slot() {
    if (frames_.empty()) return &doc_;
    Frame& top = frames_.back();
    if (!top.value) return nullptr;
    if (top.array) return &top.value->get_ref<Json::array_t&>().emplace_back();
    return &(*top.value)[top.key];
  }

  template <class Value>
  bool Scalar(Value&& value, const char* type) {
    if (!frames_.empty() && ListOfParent() >= 0) {
      throw Refusal(Path(), std::string("expected an object, found ") + type);
    }
    if (Json* slot = Slot()) *slot = Json(std::forward<Value>(value));
    if (!frames_.empty() && frames_.back().array) ++frames_.back().next;
    return true;
  }

  Frame Open(const char* type) {
    if (frames_.size() >= kMaxNesting) {
      throw Refusal(Path(), "nested more than " + std::to_string(kMaxNesting) + " levels deep");
    }
    if (!frames_.empty() && std::string_view(type) == "array" && ListOfParent() >= 0) {
      throw Refusal(Path(), "expected an object, found array");
    }
    Frame frame;
    const bool diverted = !frames_.empty() && ListOfParent() >= 0;
    if (!diverted) {
      if (Json* slot = Slot()) {
        *slot = std::string_view(type) == "array" ? Json::array() : Json::object();
        frame.value = slot;
      }
    }
    return frame;
  }

  // A product is the value of the document's "root", or an element of a product's "children".
  int ProductDepth() const {
    if (frames_.size() == 1) return !frames_[0].array && frames_[0].key == "root" ? 0 : -1;
    if (frames_.size() < 3 || !frames_.back().array) return -1;
    const Frame& father = frames_[frames_.size() - 2];
    if (father.product < 0 || father.key != "children") return -1;
    if (father.product + 1 > kMaxProductDepth) {
      throw Refusal(Path(), "products nested more than " + std::to_string(kMaxProductDepth) + " levels deep");
    }
    return father.product + 1;
  }

  void Close() {
    frames_.pop_back();
    if (!frames_.empty() && frames_.back().array) ++frames_.back().next;
  }

  const std::string& text_;
  Json& doc_;
  Lists& sets_;
  std::vector<Frame> frames_;
  const char* seen_ = nullptr;
  size_t divertedAt_ = 0;
};
}  // namespace

void QelModelJsonReader::Read(const std::string& text, nlohmann::json& doc, std::vector<SetLists>& sets) {
  doc = nullptr;
  sets.clear();
  Reader(text, doc, sets).Read();
}
