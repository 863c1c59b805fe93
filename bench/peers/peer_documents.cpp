// Key-file text to an image and to an item tree, beside the documents that other libraries make of the same
// content in their formats: nanoseconds of the processor for each node of the document that is made.
#include <libxml/parser.h>
#include <libxml/tree.h>
#include <rapidjson/document.h>

#include <cstddef>
#include <iostream>
#include <memory>
#include <pugixml.hpp>
#include <stdexcept>
#include <string>
#include <utility>

#include "content.h"
#include "generated_model.h"
#include "generated_template.h"
#include "keyfile/item_tree.h"
#include "keyfile/reader.h"
#include "platform/kvf2004.h"
#include "process_cost.h"
#include "ratio_table.h"
#include "samples.h"

namespace {

using namespace tessal;
using namespace tessal::bench;

constexpr int kElements = 10'000;
constexpr int kRounds = 21;

void Require(bool isRead, const char* reader) {
  if (!isRead) throw std::runtime_error(std::string(reader) + " can not read the content");
}

/// A text that the key-file library has read.
class Image final {
 public:
  explicit Image(std::string text) : handle(kvfLoadText(std::move(text))) {
    Require(handle != 0, "the library");
  }
  Image(const Image&) = delete;
  Image& operator=(const Image&) = delete;
  ~Image() { kvfClose(&handle); }

 private:
  KvfHandle handle;
};

using XmlDocument = std::unique_ptr<xmlDoc, decltype(&xmlFreeDoc)>;
using JsonDocument = std::unique_ptr<rapidjson::Document>;
using PugiDocument = std::unique_ptr<pugi::xml_document>;

// The readers. Those that read in place use up a text of their own; the others leave it alone.

std::unique_ptr<Image> ReadImage(const std::string& text) {
  return std::make_unique<Image>(text);
}

std::unique_ptr<Image> ReadImageInPlace(std::string& text) {
  return std::make_unique<Image>(std::move(text));
}

std::unique_ptr<CKvfItemTree> ReadItemTree(const std::string& text) {
  auto tree = std::make_unique<CKvfItemTree>();
  ReadTree(text, *tree);
  return tree;
}

JsonDocument ReadJson(const std::string& text) {
  auto document = std::make_unique<rapidjson::Document>();
  document->Parse(text.data(), text.size());
  Require(!document->HasParseError(), "RapidJSON");
  return document;
}

/// Leaves numbers as texts, as the image does.
JsonDocument ReadJsonInPlace(std::string& text) {
  auto document = std::make_unique<rapidjson::Document>();
  document->ParseInsitu<rapidjson::kParseNumbersAsStringsFlag | rapidjson::kParseInsituFlag>(text.data());
  Require(!document->HasParseError(), "RapidJSON");
  return document;
}

PugiDocument ReadPugi(const std::string& text) {
  auto document = std::make_unique<pugi::xml_document>();
  Require(document->load_buffer(text.data(), text.size()), "pugixml");
  return document;
}

PugiDocument ReadPugiInPlace(std::string& text) {
  auto document = std::make_unique<pugi::xml_document>();
  Require(document->load_buffer_inplace(text.data(), text.size()), "pugixml");
  return document;
}

XmlDocument ReadXml(const std::string& text) {
  XmlDocument document(xmlReadMemory(text.data(), static_cast<int>(text.size()), nullptr, nullptr, 0),
                       xmlFreeDoc);
  Require(document != nullptr, "libxml2");
  return document;
}

// Their nodes: what carries a name or a value.

std::size_t Nodes(const rapidjson::Value& value) {
  std::size_t count = 1;
  if (value.IsObject()) {
    for (const auto& member : value.GetObject()) count += 1 + Nodes(member.value);
  } else if (value.IsArray()) {
    for (const auto& item : value.GetArray()) count += Nodes(item);
  }
  return count;
}

std::size_t Nodes(pugi::xml_node node) {
  std::size_t count = 1;
  for (const pugi::xml_node child : node) count += Nodes(child);
  return count;
}

std::size_t Nodes(const xmlNode* node) {
  std::size_t count = 1;
  for (const xmlNode* child = node->children; child != nullptr; child = child->next) count += Nodes(child);
  return count;
}

/// Seconds of the processor.
struct ReadCost {
  double reading;
  double withRelease;
};

template <class Read>
Work<ReadCost> Timed(const std::string& text, Read read) {
  return [&text, read] {
    std::string own = text;
    const ProcessorClock clock;
    auto document = read(own);
    const double reading = clock.Seconds();
    document.reset();
    return ReadCost{reading, clock.Seconds()};
  };
}

/// A reader, with the number of nodes in the document that it makes.
struct Reader {
  Work<ReadCost> read;
  std::size_t nodes;
};

/// A reader of ours and one of a peer.
struct Pair {
  std::string work;
  std::string peer;
  Reader ours;
  Reader theirs;
};

void PrintRows(const RatioTable& table, const Pair& pair, const std::vector<ReadCost>& ours,
               const std::vector<ReadCost>& theirs) {
  const auto perNode = [](const Reader& reader) { return 1e9 / static_cast<double>(reader.nodes); };
  const double ourScale = perNode(pair.ours);
  const double theirScale = perNode(pair.theirs);
  const double ourTotal = MedianOf(ours, &ReadCost::withRelease);
  const double theirTotal = MedianOf(theirs, &ReadCost::withRelease);
  const std::string released = pair.work + ", with the release";
  table.PrintRow(pair.work, pair.peer, "ns/node", ourScale * MedianOf(ours, &ReadCost::reading),
                 theirScale * MedianOf(theirs, &ReadCost::reading));
  table.PrintRow(released, pair.peer, "ns/node", ourScale * ourTotal, theirScale * theirTotal);
  table.PrintRow(released, pair.peer, "ms in all", 1e3 * ourTotal, 1e3 * theirTotal);
}

void PrintPairs(const std::vector<Pair>& pairs) {
  std::vector<Work<ReadCost>> works;
  for (const Pair& pair : pairs) works.insert(works.end(), {pair.ours.read, pair.theirs.read});
  const auto costs = InTurns(works, kRounds);
  const RatioTable table;
  for (std::size_t place = 0; place < pairs.size(); ++place) {
    PrintRows(table, pairs[place], costs[2 * place], costs[2 * place + 1]);
  }
}

void Compare() {
  const std::string text = TemplateText(GeneratedModel(kElements));
  std::string json;
  std::string xml;
  std::size_t ourNodes = 0;
  {
    CKvfItemTree tree;
    ReadTree(text, tree);
    json = ContentAsJson(tree);
    xml = ContentAsXml(tree);
    ourNodes = CountNodes(tree);
  }
  const std::size_t jsonNodes = Nodes(*ReadJson(json));
  const std::size_t pugiNodes = Nodes(ReadPugi(xml)->document_element());
  const std::size_t xmlNodes = Nodes(xmlDocGetRootElement(ReadXml(xml).get()));
  std::cout << kElements << " elements: key file " << text.size() << " bytes, " << ourNodes << " nodes; JSON "
            << json.size() << " bytes, " << jsonNodes << " nodes; XML " << xml.size() << " bytes, "
            << pugiNodes << " nodes\n";
  const std::string image = "key-file text to an image";
  const std::string inPlace = "key-file text to an image, in place";
  const Reader imageReader = {Timed(text, ReadImage), ourNodes};
  const Reader inPlaceReader = {Timed(text, ReadImageInPlace), ourNodes};
  PrintPairs({
      {image, "RapidJSON", imageReader, {Timed(json, ReadJson), jsonNodes}},
      {inPlace, "RapidJSON, numbers as texts", inPlaceReader, {Timed(json, ReadJsonInPlace), jsonNodes}},
      {image, "pugixml", imageReader, {Timed(xml, ReadPugi), pugiNodes}},
      {inPlace, "pugixml", inPlaceReader, {Timed(xml, ReadPugiInPlace), pugiNodes}},
      {image, "libxml2", imageReader, {Timed(xml, ReadXml), xmlNodes}},
      {"key-file text to an item tree",
       "libxml2",
       {Timed(text, ReadItemTree), ourNodes},
       {Timed(xml, ReadXml), xmlNodes}},
  });
}

}  // namespace

int main() {
  return RunMain("peer_documents", Compare);
}
