#pragma once

/// The words of a composition's file: an element for the whole, in it the nodes, in each its values and inputs, all of
/// them with attributes and nothing else. An input refers to any node of the file by its name.
namespace Kv::FwCompositionFormat
{

constexpr char const* composition = "composition";
constexpr char const* node = "node";
constexpr char const* value = "value";
constexpr char const* input = "input";

/// Of the whole: the version of these words. A file without one is of the first.
constexpr char const* version = "version";
constexpr int currentVersion = 1;

/// Of a node, a value or an input.
constexpr char const* name = "name";
/// Of a node.
constexpr char const* type = "type";
/// Of a value.
constexpr char const* text = "text";

} // namespace Kv::FwCompositionFormat
