// SVG reading over libxml2.
#include "tests/framework/svg_reader.h"

#include <libxml/parser.h>
#include <libxml/tree.h>

#include <memory>
#include <sstream>
#include <stdexcept>

namespace {

std::string Text(const xmlChar* value) { return value != nullptr ? reinterpret_cast<const char*>(value) : ""; }

SvgNode Convert(xmlNode* element) {
  SvgNode node;
  node.name = Text(element->name);
  for (xmlAttr* a = element->properties; a != nullptr; a = a->next) {
    std::unique_ptr<xmlChar, void (*)(void*)> value(xmlNodeListGetString(element->doc, a->children, 1),
                                                     [](void* p) { xmlFree(p); });
    node.attributes[Text(a->name)] = Text(value.get());
  }
  for (xmlNode* child = element->children; child != nullptr; child = child->next) {
    if (child->type == XML_ELEMENT_NODE) node.children.push_back(Convert(child));
    if (child->type == XML_TEXT_NODE && node.name == "text") node.text += Text(child->content);
  }
  return node;
}

void Collect(const SvgNode& node, const std::function<bool(const SvgNode&)>& match, std::vector<const SvgNode*>& out) {
  if (match(node)) out.push_back(&node);
  for (const SvgNode& child : node.children) Collect(child, match, out);
}

}  // namespace

std::string SvgNode::Attribute(const std::string& key) const {
  const auto it = attributes.find(key);
  return it == attributes.end() ? std::string() : it->second;
}

std::set<std::string> SvgNode::States() const {
  std::set<std::string> words;
  std::istringstream in(Attribute("data-state"));
  for (std::string word; in >> word;) words.insert(word);
  return words;
}

SvgNode ParseSvg(const std::string& svg) {
  std::unique_ptr<xmlDoc, void (*)(xmlDoc*)> doc(
      xmlReadMemory(svg.data(), static_cast<int>(svg.size()), "render.svg", "UTF-8", XML_PARSE_NONET | XML_PARSE_NOERROR),
      xmlFreeDoc);
  if (!doc) throw std::runtime_error("the render is not well-formed XML");
  return Convert(xmlDocGetRootElement(doc.get()));
}

std::vector<const SvgNode*> FindAll(const SvgNode& root, const std::function<bool(const SvgNode&)>& match) {
  std::vector<const SvgNode*> out;
  Collect(root, match, out);
  return out;
}

const SvgNode* FindControl(const SvgNode& root, int id) {
  const auto found = FindAll(root, [id](const SvgNode& n) { return n.Attribute("data-id") == std::to_string(id); });
  return found.empty() ? nullptr : found.front();
}

std::vector<std::string> TextsIn(const SvgNode& node) {
  std::vector<std::string> texts;
  for (const SvgNode* t : FindAll(node, [](const SvgNode& n) { return n.name == "text"; })) texts.push_back(t->text);
  return texts;
}

std::vector<std::string> IconsIn(const SvgNode& node) {
  std::vector<std::string> icons;
  for (const SvgNode* g : FindAll(node, [](const SvgNode& n) { return !n.Attribute("data-icon").empty(); })) {
    icons.push_back(g->Attribute("data-icon"));
  }
  return icons;
}
