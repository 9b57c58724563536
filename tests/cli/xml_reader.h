#pragma once

// Just enough XML to tell whether a picture vekcfg wrote is well formed, and
// what elements it holds.

#include <map>
#include <string>
#include <vector>

namespace cli_testing
{

struct XmlElement
{
    std::string name;
    std::map<std::string, std::string> attributes;
};

// True when `text` is one well-formed XML document (declaration, comments,
// elements, attributes, character and entity references); `elements` then
// holds its elements in document order. `error` says where it is not.
bool ReadXml(const std::string& text, std::vector<XmlElement>* elements, std::string* error);

} // namespace cli_testing
