#include "analysis/unit_database.h"

#include <udunits2.h>
#include <clocale>
#include <cmath>
#include <memory>
#include <new>
#include <span>

namespace tessal {

namespace {

/// The library reads numbers by the locale; those of units have points.
class PlainLocale final {
 public:
  PlainLocale() : plain(newlocale(LC_ALL_MASK, "C", nullptr)) {
    if (plain == nullptr) throw std::bad_alloc();
    former = uselocale(plain);
  }
  PlainLocale(const PlainLocale&) = delete;
  PlainLocale& operator=(const PlainLocale&) = delete;
  ~PlainLocale() {
    uselocale(former);
    freelocale(plain);
  }

 private:
  locale_t plain;
  locale_t former = nullptr;
};

struct FreeSystem {
  void operator()(ut_system* system) const { ut_free_system(system); }
};
struct FreeUnit {
  void operator()(ut_unit* unit) const { ut_free(unit); }
};

struct Database {
  std::unique_ptr<ut_system, FreeSystem> system;
  std::string failure;
};

/// UDUNITS does not survive an allocation that fails while it reads its database, so what it takes, about
/// half a megabyte, is asked for beforehand. Raises `std::bad_alloc`.
void RequireMemory() {
  constexpr std::size_t kAmple = std::size_t{2} << 20U;
  const auto reserve = std::make_unique<volatile char[]>(kAmple);
  reserve[0] = 0;
}

Database ReadDatabase() {
  RequireMemory();
  ut_set_error_message_handler(ut_ignore);
  const PlainLocale plain;
  Database database;
  database.system.reset(ut_read_xml(nullptr));
  if (database.system) return database;
  if (ut_get_status() == UT_OS) throw std::bad_alloc();
  ut_status status = UT_SUCCESS;
  const char* path = ut_get_path_xml(nullptr, &status);
  database.failure = "the unit database '" + std::string(path == nullptr ? "" : path) + "' can not be read";
  return database;
}

const Database& TheDatabase() {
  static const Database kDatabase = ReadDatabase();
  return kDatabase;
}

/// A base unit's place by its symbol; none for the radian, which is 1.
struct BaseSymbol {
  std::string_view symbol;
  BaseUnit base;
};
constexpr BaseSymbol kBaseSymbols[] = {
    {"s", BaseUnit::Second}, {"m", BaseUnit::Metre},  {"kg", BaseUnit::Kilogram}, {"A", BaseUnit::Ampere},
    {"K", BaseUnit::Kelvin}, {"mol", BaseUnit::Mole}, {"cd", BaseUnit::Candela},
};

void MultiplyByBase(Unit& unit, const ut_unit* base, int power) {
  const char* symbol = ut_get_symbol(base, UT_ASCII);
  if (symbol == nullptr) return;
  for (const BaseSymbol& row : kBaseSymbols) {
    if (row.symbol == symbol) unit.Power(row.base) += power;
  }
}

Unit& UnitOf(void* argument) {
  return *static_cast<Unit*>(argument);
}

ut_status VisitBasic(const ut_unit* unit, void* argument) {
  MultiplyByBase(UnitOf(argument), unit, 1);
  return UT_SUCCESS;
}

ut_status VisitProduct(const ut_unit* /*unit*/, int count, const ut_unit* const* bases, const int* powers,
                       void* argument) {
  const auto size = static_cast<std::size_t>(count);
  const std::span<const int> ofBases(powers, size);
  for (std::size_t place = 0; place < size; ++place) {
    MultiplyByBase(UnitOf(argument), std::span(bases, size)[place], ofBases[place]);
  }
  return UT_SUCCESS;
}

extern const ut_visitor kVisitor;

ut_status VisitGalilean(const ut_unit* /*unit*/, double scale, const ut_unit* underlying, double /*offset*/,
                        void* argument) {
  if (!(scale > 0)) return UT_MEANINGLESS;
  UnitOf(argument).logFactor += std::log(scale);
  return ut_accept_visitor(underlying, &kVisitor, argument);
}

ut_status VisitTimestamp(const ut_unit* /*unit*/, const ut_unit* /*time*/, double /*origin*/,
                         void* /*argument*/) {
  return UT_MEANINGLESS;
}

ut_status VisitLogarithmic(const ut_unit* /*unit*/, double /*base*/, const ut_unit* /*reference*/,
                           void* /*argument*/) {
  return UT_MEANINGLESS;
}

const ut_visitor kVisitor = {VisitBasic, VisitProduct, VisitGalilean, VisitTimestamp, VisitLogarithmic};

}  // namespace

const std::string& UnitDatabaseFailure() {
  return TheDatabase().failure;
}

std::optional<Unit> UnitInDatabase(std::string_view text) {
  const Database& database = TheDatabase();
  if (!database.system) return std::nullopt;
  const PlainLocale plain;
  const std::string terminated(text);
  const std::unique_ptr<ut_unit, FreeUnit> parsed(
      ut_parse(database.system.get(), terminated.c_str(), UT_ASCII));
  if (!parsed) {
    if (ut_get_status() == UT_OS) throw std::bad_alloc();
    return std::nullopt;
  }
  Unit unit;
  const ut_status status = ut_accept_visitor(parsed.get(), &kVisitor, &unit);
  if (status == UT_OS) throw std::bad_alloc();
  if (status != UT_SUCCESS || !std::isfinite(unit.logFactor)) return std::nullopt;
  return unit;
}

}  // namespace tessal
