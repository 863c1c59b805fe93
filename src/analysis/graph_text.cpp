// Graphs in the languages of programs that draw them. Whatever the bytes of a template, the texts are in
// UTF-8, and nothing in them is taken for markup.
#include <array>
#include <span>

#include "analysis/dependency_graph.h"
#include "platform/text_encoding.h"
#include "platform/xml_text.h"

namespace tessal {

namespace {

/// How nodes of a kind are drawn: a shape of dot, and the brackets of Mermaid's shape.
struct Drawing {
  ElementKind kind;
  std::string_view shape;
  std::string_view open;
  std::string_view close;
};

constexpr std::array kDrawings = {
    Drawing{ElementKind::StateVariable, "box, style=\"filled,bold\", fillcolor=\"#dbe9f6\"", "[", "]"},
    Drawing{ElementKind::SpecieStateVariable, "box, style=\"filled,bold\", fillcolor=\"#e3f1dd\"", "[", "]"},
    Drawing{ElementKind::Process, "ellipse", "([", "])"},
    Drawing{ElementKind::ArithmeticExpression, "ellipse", "([", "])"},
    Drawing{ElementKind::Constant, "plaintext", "[/", "/]"},
    Drawing{ElementKind::SpecieConstant, "plaintext", "[/", "/]"},
    Drawing{ElementKind::Forcing, "invhouse", "[\\", "/]"},
    Drawing{ElementKind::SpecieForcing, "invhouse", "[\\", "/]"},
    Drawing{ElementKind::DerivedOutput, "note", ">", "]"},
};
constexpr Drawing kOther = {ElementKind::None, "box, style=rounded", "(", ")"};

const Drawing& DrawingOf(ElementKind kind) {
  for (const Drawing& drawing : kDrawings) {
    if (drawing.kind == kind) return drawing;
  }
  return kOther;
}

struct Escape {
  char character;
  std::string_view text;
};

/// In dot a text may have references to characters, as in HTML, and words such as \N for the node.
constexpr std::array kDotEscapes = {Escape{'"', "\\\""}, Escape{'\\', "\\\\"}, Escape{'&', "&amp;"}};
constexpr std::array kMermaidEscapes = {Escape{'"', "#34;"}, Escape{'#', "#35;"}, Escape{'&', "#38;"},
                                        Escape{'<', "#60;"}, Escape{'>', "#62;"}, Escape{'`', "#96;"},
                                        Escape{'\\', "#92;"}};

std::string Escaped(std::string_view bytes, std::span<const Escape> escapes) {
  constexpr unsigned char kFirstPrintable = 0x20;
  std::string text;
  for (const char character : ToUtf8(bytes)) {
    std::string_view escaped;
    for (const Escape& escape : escapes) {
      if (escape.character == character) escaped = escape.text;
    }
    if (!escaped.empty()) {
      text += escaped;
    } else {
      text += static_cast<unsigned char>(character) < kFirstPrintable ? ' ' : character;
    }
  }
  return text;
}

std::string NodeName(std::size_t place) {
  return "n" + std::to_string(place);
}

void AppendKey(std::string& text, std::string_view target, std::string_view name, std::string_view type) {
  text += "  <key id=\"" + std::string(name) + "\" for=\"" + std::string(target) + "\" attr.name=\"" +
          std::string(name) + "\" attr.type=\"" + std::string(type) + "\"/>\n";
}

void AppendData(std::string& text, std::string_view key, std::string_view value) {
  text += "<data key=\"" + std::string(key) + "\">" + XmlText(value) + "</data>";
}

}  // namespace

std::string GraphAsDot(const DependencyGraph& graph) {
  std::string text =
      "digraph template {\n"
      "  rankdir=LR;\n"
      "  node [fontname=\"sans-serif\", fontsize=11];\n"
      "  edge [color=\"#555555\"];\n";
  for (std::size_t place = 0; place < graph.nodes.size(); ++place) {
    const GraphNode& node = graph.nodes[place];
    const std::string symbol = Escaped(node.symbol, kDotEscapes);
    const std::string description = Escaped(node.description, kDotEscapes);
    text += "  " + NodeName(place) + " [label=\"" + symbol +
            "\", shape=" + std::string(DrawingOf(node.kind).shape) + ", tooltip=\"" +
            (description.empty() ? symbol : description) + "\"];\n";
  }
  for (const GraphEdge& edge : graph.edges) {
    text += "  " + NodeName(edge.source) + " -> " + NodeName(edge.target) +
            (edge.isDirect ? ";\n" : " [style=dashed];\n");
  }
  return text + "}\n";
}

std::string GraphAsMermaid(const DependencyGraph& graph) {
  std::string text = "flowchart LR\n";
  for (std::size_t place = 0; place < graph.nodes.size(); ++place) {
    const GraphNode& node = graph.nodes[place];
    const Drawing& drawing = DrawingOf(node.kind);
    text += "  " + NodeName(place) + std::string(drawing.open) + '"' + Escaped(node.symbol, kMermaidEscapes) +
            '"' + std::string(drawing.close) + "\n";
  }
  for (const GraphEdge& edge : graph.edges) {
    text +=
        "  " + NodeName(edge.source) + (edge.isDirect ? " --> " : " -.-> ") + NodeName(edge.target) + "\n";
  }
  return text;
}

std::string GraphAsGraphml(const DependencyGraph& graph) {
  std::string text =
      "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
      "<graphml xmlns=\"http://graphml.graphdrawing.org/xmlns\">\n";
  for (const std::string_view name : {"symbol", "kind", "unit", "description"}) {
    AppendKey(text, "node", name, "string");
  }
  AppendKey(text, "node", "level", "int");
  AppendKey(text, "edge", "direct", "boolean");
  text += "  <graph id=\"template\" edgedefault=\"directed\">\n";
  for (std::size_t place = 0; place < graph.nodes.size(); ++place) {
    const GraphNode& node = graph.nodes[place];
    text += "    <node id=\"" + NodeName(place) + "\">";
    AppendData(text, "symbol", node.symbol);
    AppendData(text, "kind", KindText(node.kind));
    AppendData(text, "unit", node.unit);
    AppendData(text, "description", node.description);
    AppendData(text, "level", std::to_string(node.level));
    text += "</node>\n";
  }
  for (const GraphEdge& edge : graph.edges) {
    text += "    <edge source=\"" + NodeName(edge.source) + "\" target=\"" + NodeName(edge.target) + "\">";
    AppendData(text, "direct", edge.isDirect ? "true" : "false");
    text += "</edge>\n";
  }
  return text + "  </graph>\n</graphml>\n";
}

}  // namespace tessal
