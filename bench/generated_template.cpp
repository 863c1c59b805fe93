#include "generated_template.h"

#include <stdexcept>
#include <string_view>
#include <utility>

#include "generated_model.h"
#include "platform/file_replacement.h"

namespace tessal::bench {

namespace {

class TemplateWriter final {
 public:
  explicit TemplateWriter(const GeneratedModel& written) : model(written) {}

  std::string Text() {
    text = "// Tessal template\r\n\r\n[TESSAL_SETUP]\r\n";
    Head("A generated template");
    Collection("STATE_VARIABLES", "STATE_VARIABLE_", model.stateVariables, [this](int place) {
      Base(kind::kStateVariable, place);
      text += "SCOPE = 'WC'\r\nTRANSPORT = 'ADVECTION_DISPERSION'\r\nUNIT = 'mg/l'\r\n";
      Range();
    });
    const auto input = [this](std::string_view kind) {
      return [this, kind](int place) {
        Base(kind, place);
        text +=
            "IS_USER_SPECIFIED = 'YES'\r\nBUILT_IN_ID = -1\r\nSCOPE = 'NOT_SPECIFIED'\r\n"
            "SPATIAL_VARIATION = 'NONE'\r\nUNIT = '/d'\r\n";
        Range();
      };
    };
    Collection("CONSTANTS", "CONSTANT_", model.constants, input(kind::kConstant));
    Collection("FORCINGS", "FORCING_", model.forcings, input(kind::kForcing));
    Collection("AUXILIARY_VARIABLES", "AUXILIARY_VARIABLE_", Count(model.auxiliaries), [this](int place) {
      Base(kind::kAuxiliary, place);
      text +=
          "OUTPUT = 'YES'\r\nSCOPE = 'NOT_SPECIFIED'\r\nSPATIAL_VARIATION = 'HORISONTAL_AND_VERTICAL'\r\n"
          "UNIT = '-'\r\n";
      Expression("EXPRESSION", model.auxiliaries, place);
    });
    Collection("PROCESSES", "PROCESS_", Count(model.processes), [this](int place) {
      Base(kind::kProcess, place);
      text +=
          "OUTPUT = 'YES'\r\nPROCESS_TYPE = 'TRANSFORMATION'\r\nSCOPE = 'WC'\r\n"
          "SPATIAL_VARIATION = 'HORISONTAL_AND_VERTICAL'\r\nUNIT = 'mg/l/d'\r\n";
      Expression("EXPRESSION", model.processes, place);
      text += "CONTROLID = -1\r\nCONTROLVALUE = 0.8\r\n";
    });
    text += "[STATE_VARIABLE_EQUATIONS]\r\n";
    for (int place = 1; place <= Count(model.equations); ++place) {
      text += "[STATE_VARIABLE_EQUATION_" + std::to_string(place) + "]\r\n";
      Expression(NameOf(kind::kStateVariable, place), model.equations, place);
      text += "EndSect\r\n\r\n";
    }
    text += "EndSect\r\n\r\nEndSect\r\n\r\n";
    return std::move(text);
  }

 private:
  using Expressions = std::vector<GeneratedExpression>;

  static int Count(const Expressions& expressions) { return static_cast<int>(expressions.size()); }

  template <class WriteElement>
  void Collection(const char* name, const char* prefix, int count, WriteElement writeElement) {
    text += "[" + std::string(name) + "]\r\n";
    Head("");
    for (int place = 1; place <= count; ++place) {
      text += "[" + (prefix + std::to_string(place)) + "]\r\n";
      writeElement(place);
      text += "EndSect\r\n\r\n";
    }
    text += "EndSect\r\n\r\n";
  }

  void Head(const std::string& description) {
    text += "DESCRIPTION = '" + description + "'\r\nONLINE_HELP = ''\r\nDOCUMENTATION = ''\r\n";
  }

  void Base(std::string_view kind, int place) {
    const std::string symbol = NameOf(kind, place);
    text += "SYMBOL = '" + symbol + "'\r\nID = " + std::to_string(++id) + "\r\n";
    Head(DescriptionOf(symbol));
    text += "UNQ_TYPE = 999\r\nUNQ_UNIT = 0\r\n";
  }

  void Range() { text += "DEFAULT_VALUE = 0.25\r\nMIN_VALUE = 0\r\nMAX_VALUE = 100\r\n"; }

  void Expression(const std::string& keyword, const Expressions& expressions, int place) {
    const GeneratedExpression& expression = expressions[static_cast<std::size_t>(place - 1)];
    text += keyword + " = '\"" + Write(expression, kTemplateDialect) + "\"'\r\n";
  }

  const GeneratedModel& model;
  int id = 0;
  std::string text;
};

std::string FileOf(const ScratchFolder& folder, const GeneratedModel& model) {
  const std::string path = folder.File("model.tessal");
  const std::string failure = ReplaceFile(path, TemplateText(model));
  if (!failure.empty()) throw std::runtime_error(failure);
  return path;
}

}  // namespace

std::string TemplateText(const GeneratedModel& model) {
  return TemplateWriter(model).Text();
}

std::string FileOfSize(const ScratchFolder& folder, std::int64_t elements) {
  return FileOf(folder, GeneratedModel(static_cast<int>(elements)));
}

std::string FileOfConstants(const ScratchFolder& folder, int count) {
  return FileOf(folder, GeneratedModel::OfConstants(count));
}

}  // namespace tessal::bench
