// Reads a scene's text into a JSON document, as json::parse does, but keeps
// the line and column of a failure and notes keys given twice in one object
// (where the last one silently wins).
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <string_view>
#include <vector>

namespace scene_player {

// Places in a document, as messages name them: `timeline[3].do[1]`.
std::string Member(const std::string& place, const std::string& key);
std::string Element(const std::string& place, std::size_t index);

// Throws SceneError for text that is not JSON. Adds "PLACE: message" to
// `warnings` for each key given twice in one object.
nlohmann::json ReadJsonDocument(std::string_view text, std::vector<std::string>& warnings);

}  // namespace scene_player
