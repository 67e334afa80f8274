// Reads a rendered SVG back into a tree of elements, so that tests compare what a picture
// shows (which windows, states, texts, icons) instead of its bytes.
#pragma once

#include <functional>
#include <map>
#include <set>
#include <string>
#include <vector>

struct SvgNode {
  std::string name;
  std::map<std::string, std::string> attributes;
  std::string text;  // the text of a <text> element
  std::vector<SvgNode> children;

  std::string Attribute(const std::string& key) const;
  std::set<std::string> States() const;  // the words of data-state
};

// Parses a document; throws std::runtime_error when it is not well-formed XML.
SvgNode ParseSvg(const std::string& svg);

std::vector<const SvgNode*> FindAll(const SvgNode& root, const std::function<bool(const SvgNode&)>& match);
// The window with a control id (its <svg data-id> element), or null.
const SvgNode* FindControl(const SvgNode& root, int id);
// Every text drawn inside a node, in drawing order.
std::vector<std::string> TextsIn(const SvgNode& node);
// The icon ids drawn inside a node (data-icon), in drawing order.
std::vector<std::string> IconsIn(const SvgNode& node);
