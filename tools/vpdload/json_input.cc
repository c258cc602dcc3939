#include "json_input.h"

#include <cstdio>
#include <utility>
#include <vector>

#include "text_bytes.h"

namespace vpdload {

namespace {

using nlohmann::json;

bool plainWord(const std::string& key) {
  if (key.empty()) return false;
  for (char c : key) {
    bool ok =
        (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
    if (!ok) return false;
  }
  return true;
}

// The library's message without its "[json.exception.parse_error.101] " tag. It quotes the
// input near the error, which may hold any bytes: those are written as \xHH.
std::string parseMessage(const char* what) {
  std::string m = what;
  if (!m.empty() && m[0] == '[') {
    std::size_t close = m.find("] ");
    if (close != std::string::npos) m.erase(0, close + 2);
  }
  std::string out;
  for (unsigned char c : m) {
    if (c >= 0x20 && c < 0x7f) {
      out += static_cast<char>(c);
    } else {
      char hex[8];
      std::snprintf(hex, sizeof hex, "\\x%02x", c);
      out += hex;
    }
  }
  return out;
}

// Builds the document from the parser's events, like the library's own builder, but stops
// at a key given twice in one object (which the library would resolve silently by keeping
// the last value) and at nesting deeper than kMaxJsonDepth.
class StrictBuilder : public nlohmann::json_sax<json> {
 public:
  StrictBuilder(json* root, const ElementSink& sink) : root_(root), sink_(sink) {}

  const std::string& error() const { return error_; }

  bool null() override { return add(nullptr); }
  bool boolean(bool v) override { return add(v); }
  bool number_integer(number_integer_t v) override { return add(v); }
  bool number_unsigned(number_unsigned_t v) override { return add(v); }
  bool number_float(number_float_t v, const string_t&) override { return add(v); }
  bool string(string_t& v) override { return add(std::move(v)); }
  bool binary(binary_t&) override { return fail(": binary values are not JSON"); }

  bool start_object(std::size_t) override { return open(json::object()); }
  bool key(string_t& k) override {
    if (open_.back()->contains(k)) return fail(keyPath(path(false), k) + ": key given twice");
    keys_.back() = std::move(k);
    return true;
  }
  bool end_object() override { return close(); }
  bool start_array(std::size_t) override { return open(json::array()); }
  bool end_array() override { return close(); }

  bool parse_error(std::size_t, const std::string&, const nlohmann::detail::exception& e) override {
    return fail(parseMessage(e.what()));
  }

 private:
  // Where the next value goes: the place of the element or member being read. Without
  // `member`, the place of the innermost open array or object itself.
  std::string path(bool member = true) const {
    std::string p;
    std::size_t levels = open_.size() - (member || open_.empty() ? 0 : 1);
    for (std::size_t i = 0; i < levels; ++i) {
      bool inner = i + 1 < open_.size();  // an element of this one is open too
      if (open_[i]->is_array()) {
        p = indexPath(p, open_[i]->size() - (inner ? 1 : 0));
      } else {
        p = keyPath(p, keys_[i]);
      }
    }
    return p;
  }

  template <typename Value>
  bool add(Value&& v) {
    json& s = slot();
    s = json(std::forward<Value>(v));
    if (open_.size() == 2) handOver(s);
    return true;
  }

  // An element of an array in the top-level object, read whole, goes to the sink; its
  // place in the array stays, as null, so that the indexes of the next ones hold.
  void handOver(json& element) {
    if (!open_[0]->is_object() || !open_[1]->is_array()) return;
    sink_(keys_[0], open_[1]->size() - 1, element);
    element = nullptr;
  }

  json& slot() {
    if (open_.empty()) return *root_;
    json* top = open_.back();
    if (top->is_array()) {
      top->emplace_back();
      return top->back();
    }
    return (*top)[keys_.back()];
  }

  bool open(json empty) {
    if (open_.size() >= static_cast<std::size_t>(kMaxJsonDepth)) {
      return fail(path() + ": nested deeper than " + std::to_string(kMaxJsonDepth) + " levels");
    }
    json& s = slot();
    s = std::move(empty);
    open_.push_back(&s);
    keys_.emplace_back();
    return true;
  }

  bool close() {
    json* closed = open_.back();
    open_.pop_back();
    keys_.pop_back();
    if (open_.size() == 2) handOver(*closed);
    return true;
  }

  bool fail(std::string message) {
    if (error_.empty()) error_ = std::move(message);
    return false;
  }

  json* root_;
  const ElementSink& sink_;
  std::vector<json*> open_;        // the arrays and objects being read, outermost first
  std::vector<std::string> keys_;  // for objects: the key of the member being read
  std::string error_;
};

}  // namespace

std::string keyPath(const std::string& parent, const std::string& key) {
  std::string k = plainWord(key) ? key : quoted(key);
  return parent.empty() ? k : parent + "." + k;
}

std::string indexPath(const std::string& parent, std::size_t index) {
  return parent + "[" + std::to_string(index) + "]";
}

bool parseJson(const std::string& text, json* doc, std::string* error, const ElementSink& sink) {
  *doc = json();
  StrictBuilder builder(doc, sink);
  if (json::sax_parse(text, &builder)) return true;
  *error = builder.error();
  return false;
}

}  // namespace vpdload
