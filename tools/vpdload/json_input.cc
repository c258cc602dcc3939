#include "json_input.h"

#include <set>
#include <vector>

#include "text_bytes.h"

namespace vpdload {

namespace {

bool plainWord(const std::string& key) {
  if (key.empty()) return false;
  for (char c : key) {
    bool ok =
        (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
    if (!ok) return false;
  }
  return true;
}

// One open array or object while parsing, to name the place of a problem.
struct Frame {
  bool is_array = false;
  std::size_t index = 0;       // arrays: index of the element being read
  std::string key;             // objects: key of the member being read
  std::set<std::string> keys;  // objects: keys seen so far
};

struct TooDeep {};

std::string framePath(const std::vector<Frame>& frames) {
  std::string path;
  for (const Frame& f : frames) {
    path = f.is_array ? indexPath(path, f.index) : keyPath(path, f.key);
  }
  return path;
}

// Strips the library's "[json.exception.parse_error.101] " tag from a message.
std::string parseMessage(const char* what) {
  std::string m = what;
  if (!m.empty() && m[0] == '[') {
    std::size_t close = m.find("] ");
    if (close != std::string::npos) m.erase(0, close + 2);
  }
  return m;
}

}  // namespace

std::string keyPath(const std::string& parent, const std::string& key) {
  std::string k = plainWord(key) ? key : quoted(key);
  return parent.empty() ? k : parent + "." + k;
}

std::string indexPath(const std::string& parent, std::size_t index) {
  return parent + "[" + std::to_string(index) + "]";
}

bool parseJson(const std::string& text, nlohmann::json* doc, std::string* error) {
  using nlohmann::json;
  std::vector<Frame> frames;
  std::string duplicate;  // first key given twice, as a path
  // The parser reports each finished element of an array; the index moves on after it.
  auto elementDone = [&frames]() {
    if (!frames.empty() && frames.back().is_array) ++frames.back().index;
  };
  json::parser_callback_t callback = [&](int depth, json::parse_event_t event, json& parsed) {
    switch (event) {
      case json::parse_event_t::object_start:
      case json::parse_event_t::array_start:
        if (depth >= kMaxJsonDepth) throw TooDeep();
        frames.emplace_back();
        frames.back().is_array = event == json::parse_event_t::array_start;
        break;
      case json::parse_event_t::key:
        if (!frames.empty()) {
          Frame& f = frames.back();
          f.key = parsed.get<std::string>();
          if (!f.keys.insert(f.key).second && duplicate.empty()) duplicate = framePath(frames);
        }
        break;
      case json::parse_event_t::object_end:
      case json::parse_event_t::array_end:
        if (!frames.empty()) frames.pop_back();
        elementDone();
        break;
      case json::parse_event_t::value:
        elementDone();
        break;
    }
    return true;
  };
  try {
    *doc = json::parse(text, callback);
  } catch (const json::parse_error& e) {
    *error = parseMessage(e.what());
    return false;
  } catch (const TooDeep&) {
    *error =
        framePath(frames) + ": nested deeper than " + std::to_string(kMaxJsonDepth) + " levels";
    return false;
  }
  if (!duplicate.empty()) {
    *error = duplicate + ": key given twice";
    return false;
  }
  return true;
}

}  // namespace vpdload
