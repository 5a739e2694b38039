#include "json_document.h"

#include <algorithm>
#include <set>

#include "scene_parser.h"
#include "shown_text.h"

namespace scene_player {

namespace {

using nlohmann::json;

// Line and column (from 1) of a byte offset, for text that is not JSON.
std::string LineAndColumn(std::string_view text, std::size_t offset) {
  offset = std::min(offset, text.size());
  const std::string_view before = text.substr(0, offset);
  const std::size_t line = static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n')) + 1;
  const std::size_t lineStart = before.rfind('\n');
  const std::size_t column = offset - (lineStart == std::string_view::npos ? 0 : lineStart + 1) + 1;
  return "line " + std::to_string(line) + ", column " + std::to_string(column);
}

// Builds the document as json::parse does, keeping where a failure was found
// (the parser's own exception for a number too large for a double carries no
// position) and where each value stands, to name a key given twice. (The
// parser calls these members of the type it is given, so hiding the base
// class's members is enough.)
class DocumentBuilder : public nlohmann::detail::json_sax_dom_parser<json> {
  using Base = nlohmann::detail::json_sax_dom_parser<json>;

 public:
  DocumentBuilder(json& root, std::vector<std::string>& warnings) : Base(root, false), warnings_(warnings) {}

  bool null() { return Next() && Base::null(); }
  bool boolean(bool value) { return Next() && Base::boolean(value); }
  bool number_integer(json::number_integer_t value) { return Next() && Base::number_integer(value); }
  bool number_unsigned(json::number_unsigned_t value) { return Next() && Base::number_unsigned(value); }
  bool number_float(json::number_float_t value, const json::string_t& text) {
    return Next() && Base::number_float(value, text);
  }
  bool string(json::string_t& value) { return Next() && Base::string(value); }
  bool start_object(std::size_t size) {
    Next();
    levels_.emplace_back(true);
    return Base::start_object(size);
  }
  bool key(json::string_t& name) {
    Level& level = levels_.back();
    level.key = name;
    if (!level.keys.insert(name).second) {
      warnings_.push_back(Place() + ": the key " + tool_input::Quoted(name) +
                          " is given twice in one object; only the last is used");
    }
    return Base::key(name);
  }
  bool end_object() {
    levels_.pop_back();
    return Base::end_object();
  }
  bool start_array(std::size_t size) {
    Next();
    levels_.emplace_back(false);
    return Base::start_array(size);
  }
  bool end_array() {
    levels_.pop_back();
    return Base::end_array();
  }
  bool parse_error(std::size_t position, const std::string& token, const nlohmann::detail::exception& error) {
    failed = true;
    end = position;
    lastToken = token;
    id = error.id;
    message = error.what();
    return false;
  }

  bool failed = false;
  std::size_t end = 0;  // bytes read when it failed
  std::string lastToken;
  int id = 0;
  std::string message;

 private:
  struct Level {
    explicit Level(bool isObject) : object(isObject) {}
    bool object;
    std::set<std::string> keys;  // of an object
    std::string key;             // the latest of an object
    std::size_t count = 0;       // values of an array so far
  };

  // A value begins: in an array, it is the next element.
  bool Next() {
    if (!levels_.empty() && !levels_.back().object) ++levels_.back().count;
    return true;
  }

  std::string Place() const {
    std::string place;
    for (const Level& level : levels_) place = level.object ? Member(place, level.key) : Element(place, level.count - 1);
    return place.empty() ? "top level" : tool_input::Shown(place);
  }

  std::vector<std::string>& warnings_;
  std::vector<Level> levels_;
};

constexpr int kNumberOverflow = 406;  // the parser's error id for a number beyond a double

}  // namespace

std::string Member(const std::string& place, const std::string& key) { return place.empty() ? key : place + "." + key; }

std::string Element(const std::string& place, std::size_t index) {
  return place + "[" + std::to_string(index) + "]";
}

json ReadJsonDocument(std::string_view text, std::vector<std::string>& warnings) {
  json root;
  DocumentBuilder builder(root, warnings);
  if (!json::sax_parse(text, &builder) || builder.failed) {
    if (builder.id == kNumberOverflow) {
      const std::size_t start = builder.end >= builder.lastToken.size() ? builder.end - builder.lastToken.size() : 0;
      throw SceneError(LineAndColumn(text, start), "the number " + tool_input::Shown(builder.lastToken) +
                                                       " is out of range; expected a number from -1.7e308 to 1.7e308");
    }
    // The parser's message repeats the position; keep what it found and expected.
    std::string message = builder.message;
    const auto at = message.find(": ", message.find("column"));
    if (at != std::string::npos) message = message.substr(at + 2);
    throw SceneError(LineAndColumn(text, builder.end > 0 ? builder.end - 1 : 0),
                     "not JSON: " + tool_input::Shown(message));
  }
  return root;
}

}  // namespace scene_player
