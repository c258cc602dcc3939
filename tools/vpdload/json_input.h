// Reading JSON text strictly enough for an inventory that people edit by hand.
#ifndef TOOLS_VPDLOAD_JSON_INPUT_H_
#define TOOLS_VPDLOAD_JSON_INPUT_H_

#include <cstddef>
#include <functional>
#include <nlohmann/json.hpp>
#include <string>

namespace vpdload {

// Deepest nesting of arrays and objects accepted; an inventory needs seven levels.
constexpr int kMaxJsonDepth = 32;

// Receives each element of an array that is a member of the top-level object as soon as the
// element has been read whole: the member's key, the element's index and the element.
using ElementSink =
    std::function<void(const std::string& key, std::size_t index, const nlohmann::json& element)>;

// Parses `text` into `doc`. Besides malformed JSON (the message then gives line and column)
// it rejects a key given twice in one object, which the plain parser would resolve silently
// by keeping the last value, and nesting deeper than kMaxJsonDepth. Returns false and sets
// `error` (e.g. `chassis[0].fru.pn: key given twice`) on failure.
//
// Every element that `sink` receives is then replaced by null in `doc`, so that only the
// document's frame and one element at a time are ever held, however large the document.
// The sink may see elements of a document that turns out to be malformed further on.
bool parseJson(const std::string& text, nlohmann::json* doc, std::string* error,
               const ElementSink& sink);

// Paths of values in messages: `chassis[3].dca1.pn`. A key that is not a plain word is
// quoted so that the path stays readable and unambiguous.
std::string keyPath(const std::string& parent, const std::string& key);
std::string indexPath(const std::string& parent, std::size_t index);

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_JSON_INPUT_H_
