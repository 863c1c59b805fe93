#include "ui/function_tips.h"

#include <QStringList>
#include <algorithm>
#include <array>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "core/template_core.h"
#include "elements/external_function.h"
#include "expr/builtin_reference.h"
#include "expr/function_reference.h"
#include "platform/ascii.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

QString Escaped(std::string_view text) {
  return ToScreen(text).toHtmlEscaped();
}

/// A part of the language that is written like a call.
struct Form {
  std::string_view name;
  std::array<std::string_view, 3> arguments;
  std::size_t count;
};

constexpr std::array<Form, 2> kForms = {{
    {"IF", {"condition", "value if it holds", "value if not"}, 3},
    {"EXCEEDANCE_FREQUENCY", {"condition"}, 1},
}};

QString Italic(const QString& text) {
  return QStringLiteral("<i>%1</i>").arg(text);
}

QString UnitText(const FunctionReference& function, std::string_view unit) {
  const std::string words = UnitInWords(function, unit);
  return words.empty() ? QString() : QStringLiteral(" [%1]").arg(Escaped(words));
}

QString TipOfFunction(const FunctionReference& function) {
  QString tip =
      QStringLiteral("<qt><b>%1</b><br>%2").arg(Escaped(CallText(function)), Escaped(function.purpose));
  for (const ArgumentReference& argument : function.arguments) {
    tip += QStringLiteral("<br>%1: %2%3")
               .arg(Italic(Escaped(argument.name)), Escaped(argument.meaning),
                    UnitText(function, argument.unit));
  }
  tip += QStringLiteral("<br>= %1%2").arg(Escaped(function.result), UnitText(function, function.resultUnit));
  return tip + QStringLiteral("</qt>");
}

template <class Names>
QString CallWithBold(std::string_view name, const Names& names, std::size_t argument) {
  QStringList shown;
  for (const auto& each : names) {
    const QString escaped = Escaped(each);
    const bool isPresent = static_cast<std::size_t>(shown.size()) == argument;
    shown.append(isPresent ? QStringLiteral("<b>%1</b>").arg(escaped) : escaped);
  }
  return QStringLiteral("%1(%2)").arg(Escaped(name), shown.join(QStringLiteral(", ")));
}

}  // namespace

QString TipOfWord(const std::string& name) {
  if (const FunctionReference* function = ReferenceOfFunction(name)) return TipOfFunction(*function);
  const BuiltinReference* builtin = ReferenceOfBuiltin(name);
  if (builtin == nullptr) return {};
  return QStringLiteral("<qt><b>%1</b> [%2]<br>%3</qt>")
      .arg(Escaped(builtin->name), Escaped(builtin->unit), Escaped(builtin->purpose));
}

QString TipOfCall(const TemplateCore& core, const std::string& name, std::size_t argument) {
  if (const FunctionReference* function = ReferenceOfFunction(name)) {
    std::vector<std::string_view> names;
    for (const ArgumentReference& each : function->arguments) names.push_back(each.name);
    QString tip = CallWithBold(name, names, argument);
    if (argument < names.size()) {
      const ArgumentReference& present = function->arguments[argument];
      tip += QStringLiteral("<br>%1%2").arg(Escaped(present.meaning), UnitText(*function, present.unit));
    }
    return tip;
  }
  for (const Form& form : kForms) {
    if (EqualIgnoringCase(form.name, name))
      return CallWithBold(form.name, std::span(form.arguments).first(form.count), argument);
  }
  const CEL_Miscanellous* settings = core.GetMisc();
  if (settings == nullptr) return {};
  for (const auto& function : settings->ExternalFunctions()) {
    if (function->publicName.Text() != name) continue;
    constexpr std::int32_t kMostShown = 100;
    std::vector<std::string> names;
    for (std::int32_t place = 1; place <= std::min(function->parameters.IntValue(), kMostShown); ++place)
      names.push_back("argument " + std::to_string(place));
    return CallWithBold(name, names, argument);
  }
  return {};
}

}  // namespace tessal
