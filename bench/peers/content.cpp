#include "content.h"

#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>

#include <pugixml.hpp>
#include <sstream>
#include <stdexcept>

#include "keyfile/item_tree.h"
#include "keyfile/reader.h"

namespace tessal::bench {

namespace {

using JsonWriter = rapidjson::Writer<rapidjson::StringBuffer>;

const CKvfSectionItem& AsSection(const CKvfBaseItem& item) {
  return static_cast<const CKvfSectionItem&>(item);
}

const CKvfKeyItem& AsKeyword(const CKvfBaseItem& item) {
  return static_cast<const CKvfKeyItem&>(item);
}

void WriteJsonText(JsonWriter& writer, std::string_view text) {
  writer.String(text.data(), static_cast<rapidjson::SizeType>(text.size()));
}

void WriteJsonValue(JsonWriter& writer, const KvfValue& value) {
  switch (value.Type()) {
    case KvfValue::kBoolean:
      writer.Bool(value.AsBoolean());
      break;
    case KvfValue::kInteger:
      writer.Int(value.AsInteger());
      break;
    case KvfValue::kReal:
      writer.Double(value.AsReal());
      break;
    case KvfValue::kQuoted:
    case KvfValue::kPath:
      WriteJsonText(writer, value.AsString());
      break;
  }
}

void WriteJsonValues(JsonWriter& writer, std::span<const KvfValue> values) {
  if (values.size() == 1) {
    WriteJsonValue(writer, values.front());
    return;
  }
  writer.StartArray();
  for (const KvfValue& value : values) WriteJsonValue(writer, value);
  writer.EndArray();
}

void WriteJsonSection(JsonWriter& writer, const CKvfSectionItem& section) {
  writer.StartObject();
  for (const CKvfBaseItem& child : section.Children()) {
    if (child.ItemKind() == CKvfBaseItem::kComment) continue;
    WriteJsonText(writer, child.Name());
    if (child.ItemKind() == CKvfBaseItem::kSection) {
      WriteJsonSection(writer, AsSection(child));
    } else {
      WriteJsonValues(writer, AsKeyword(child).Values());
    }
  }
  writer.EndObject();
}

std::string PlainText(const KvfValue& value) {
  if (value.IsText()) return std::string(value.AsString());
  std::string text;
  value.AppendTo(text);
  return text;
}

void AppendXmlKeyword(pugi::xml_node parent, const CKvfKeyItem& keyword) {
  pugi::xml_node element = parent.append_child(std::string(keyword.Name()).c_str());
  if (keyword.Values().size() == 1) {
    element.text().set(PlainText(keyword.Values().front()).c_str());
    return;
  }
  for (const KvfValue& value : keyword.Values()) {
    element.append_child("VALUE").text().set(PlainText(value).c_str());
  }
}

void AppendXmlChildren(pugi::xml_node parent, const CKvfSectionItem& section) {
  for (const CKvfBaseItem& child : section.Children()) {
    if (child.ItemKind() == CKvfBaseItem::kSection) {
      AppendXmlChildren(parent.append_child(std::string(child.Name()).c_str()), AsSection(child));
    } else if (child.ItemKind() == CKvfBaseItem::kKeyword) {
      AppendXmlKeyword(parent, AsKeyword(child));
    }
  }
}

}  // namespace

void ReadTree(const std::string& text, CKvfSectionItem& tree) {
  if (ParseKeyFileTree(text, tree) == 0) throw std::runtime_error(KeyFileFailureText());
}

std::string ContentAsJson(const CKvfSectionItem& tree) {
  rapidjson::StringBuffer buffer;
  JsonWriter writer(buffer);
  WriteJsonSection(writer, tree);
  return {buffer.GetString(), buffer.GetSize()};
}

std::string ContentAsXml(const CKvfSectionItem& tree) {
  pugi::xml_document document;
  AppendXmlChildren(document.append_child("CONTENT"), tree);
  std::ostringstream text;
  document.save(text, "", pugi::format_raw);
  return text.str();
}

std::size_t CountNodes(const CKvfSectionItem& tree) {
  std::size_t count = 0;
  for (const CKvfBaseItem& child : tree.Children()) {
    if (child.ItemKind() == CKvfBaseItem::kSection) count += 1 + CountNodes(AsSection(child));
    if (child.ItemKind() == CKvfBaseItem::kKeyword) count += 1 + AsKeyword(child).Values().size();
  }
  return count;
}

}  // namespace tessal::bench
