#include "generated_template.h"

#include <random>
#include <stdexcept>
#include <utility>

#include "platform/file_replacement.h"

namespace tessal::bench {

namespace {

class TemplateWriter final {
 public:
  explicit TemplateWriter(int elements)
      : stateVariables(elements * 6 / 100),
        constants(elements * 30 / 100),
        forcings(elements * 14 / 100),
        auxiliaries(elements * 25 / 100),
        processes(elements * 25 / 100) {}

  /// Nothing but constants.
  static TemplateWriter OfConstants(int count) {
    TemplateWriter writer(0);
    writer.constants = count;
    return writer;
  }

  std::string Text() {
    text = "// Tessal template\r\n\r\n[TESSAL_SETUP]\r\n";
    Head("A generated template");
    Collection("STATE_VARIABLES", "STATE_VARIABLE_", stateVariables, [this](int place) {
      Base("S" + std::to_string(place));
      text += "SCOPE = 'WC'\r\nTRANSPORT = 'ADVECTION_DISPERSION'\r\nUNIT = 'mg/l'\r\n";
      Range();
    });
    const auto input = [this](const char* prefix) {
      return [this, prefix](int place) {
        Base(prefix + std::to_string(place));
        text +=
            "IS_USER_SPECIFIED = 'YES'\r\nBUILT_IN_ID = -1\r\nSCOPE = 'NOT_SPECIFIED'\r\n"
            "SPATIAL_VARIATION = 'NONE'\r\nUNIT = '/d'\r\n";
        Range();
      };
    };
    Collection("CONSTANTS", "CONSTANT_", constants, input("constant"));
    Collection("FORCINGS", "FORCING_", forcings, input("forcing"));
    Collection("AUXILIARY_VARIABLES", "AUXILIARY_VARIABLE_", auxiliaries, [this](int place) {
      Base("factor" + std::to_string(place));
      text +=
          "OUTPUT = 'YES'\r\nSCOPE = 'NOT_SPECIFIED'\r\nSPATIAL_VARIATION = 'HORISONTAL_AND_VERTICAL'\r\n"
          "UNIT = '-'\r\n";
      Expression("EXPRESSION", Any("constant", constants) + "*EXP(-" + Any("forcing", forcings) + "/(" +
                                   Any("constant", constants) + "+1)) + " + Any("factor", place));
    });
    Collection("PROCESSES", "PROCESS_", processes, [this](int place) {
      Base("rate" + std::to_string(place));
      text +=
          "OUTPUT = 'YES'\r\nPROCESS_TYPE = 'TRANSFORMATION'\r\nSCOPE = 'WC'\r\n"
          "SPATIAL_VARIATION = 'HORISONTAL_AND_VERTICAL'\r\nUNIT = 'mg/l/d'\r\n";
      Expression("EXPRESSION", "IF " + Any("S", stateVariables) + " > 0.5 THEN " +
                                   Any("factor", auxiliaries) + "*" + Any("constant", constants) + " ELSE " +
                                   Any("rate", place));
      text += "CONTROLID = -1\r\nCONTROLVALUE = 0.8\r\n";
    });
    text += "[STATE_VARIABLE_EQUATIONS]\r\n";
    for (int place = 1; place <= stateVariables; ++place) {
      text += "[STATE_VARIABLE_EQUATION_" + std::to_string(place) + "]\r\n";
      Expression("S" + std::to_string(place), Any("rate", processes) + " - " + Any("rate", processes));
      text += "EndSect\r\n\r\n";
    }
    text += "EndSect\r\n\r\nEndSect\r\n\r\n";
    return std::move(text);
  }

 private:
  /// One of the elements declared so far, or a number where there is none.
  std::string Any(const char* prefix, int count) {
    if (count < 2) return "1.5";
    return prefix + std::to_string(1 + random() % static_cast<unsigned>(count - 1));
  }

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

  void Base(const std::string& symbol) {
    text += "SYMBOL = '" + symbol + "'\r\nID = " + std::to_string(++id) + "\r\n";
    Head("What " + symbol + " means in the model");
    text += "UNQ_TYPE = 999\r\nUNQ_UNIT = 0\r\n";
  }

  void Range() { text += "DEFAULT_VALUE = 0.25\r\nMIN_VALUE = 0\r\nMAX_VALUE = 100\r\n"; }

  void Expression(const std::string& keyword, const std::string& expression) {
    text += keyword + " = '\"" + expression + "\"'\r\n";
  }

  int stateVariables;
  int constants;
  int forcings;
  int auxiliaries;
  int processes;
  int id = 0;
  std::string text;
  std::mt19937 random{1};
};

}  // namespace

ScratchFolder::ScratchFolder() {
  std::string pattern = (std::filesystem::temp_directory_path() / "tessal-bench-XXXXXX").string();
  if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("no scratch folder");
  path = pattern;
}

ScratchFolder::~ScratchFolder() {
  std::error_code ignored;
  std::filesystem::remove_all(path, ignored);
}

namespace {

std::string FileOf(const ScratchFolder& folder, const std::string& text) {
  const std::string path = folder.File("model.tessal");
  const std::string failure = ReplaceFile(path, text);
  if (!failure.empty()) throw std::runtime_error(failure);
  return path;
}

}  // namespace

std::string FileOfSize(const ScratchFolder& folder, std::int64_t elements) {
  return FileOf(folder, TemplateWriter(static_cast<int>(elements)).Text());
}

std::string FileOfConstants(const ScratchFolder& folder, int count) {
  return FileOf(folder, TemplateWriter::OfConstants(count).Text());
}

}  // namespace tessal::bench
