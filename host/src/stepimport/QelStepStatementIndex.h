#pragma once
// QelStepStatementIndex: the statements of a STEP file's data section by entity number
// ("#12=..." gives 12 -> "..." up to the closing ';'), in file order, and which statements
// refer to each entity. Views into the text, which must outlive the index. A quote inside
// a string does not end a statement; entities it cannot read are left out.
#include <string_view>
#include <unordered_map>
#include <vector>

class QelStepStatementIndex {
 public:
  explicit QelStepStatementIndex(std::string_view text);

  // The statement of entity `id` (after its '='), or empty.
  std::string_view At(long id) const;
  // Entity numbers in the order the file defines them.
  const std::vector<long>& Order() const { return order_; }
  // The entities whose statements name `id`, in file order, each once.
  const std::vector<long>& Referrers(long id) const;

 private:
  std::unordered_map<long, std::string_view> statements_;
  std::unordered_map<long, std::vector<long>> referrers_;
  std::vector<long> order_;
};
