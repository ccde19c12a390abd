#include "traces/result_types.h"

#include <algorithm>
#include <iterator>

namespace frontpanels {
namespace {

struct ListedType {
  std::int16_t resultType;
  ListedAs listedAs;
};

constexpr ListedType kListedTypes[] = {
    {10, ListedAs::Ignored},      {20, ListedAs::Ignored},

    {28, ListedAs::ClearsActive}, {29, ListedAs::ClearsActive}, {40, ListedAs::ClearsActive},
    {42, ListedAs::ClearsActive}, {43, ListedAs::ClearsActive}, {44, ListedAs::ClearsActive},

    {12, ListedAs::Counted},      {14, ListedAs::Counted},      {16, ListedAs::Counted},
    {18, ListedAs::Counted},      {19, ListedAs::Counted},      {25, ListedAs::Counted},
    {106, ListedAs::Counted},     {107, ListedAs::Counted},     {208, ListedAs::Counted},
    {210, ListedAs::Counted},     {211, ListedAs::Counted},     {212, ListedAs::Counted},
    {701, ListedAs::Counted},     {703, ListedAs::Counted},     {705, ListedAs::Counted},
    {707, ListedAs::Counted},     {721, ListedAs::Counted},     {723, ListedAs::Counted},
    {725, ListedAs::Counted},     {727, ListedAs::Counted},     {734, ListedAs::Counted},
    {735, ListedAs::Counted},
};

const ListedType* findListed(std::int16_t resultType) noexcept {
  const auto* const found =
      std::find_if(std::begin(kListedTypes), std::end(kListedTypes),
                   [resultType](const ListedType& row) { return row.resultType == resultType; });
  return found == std::end(kListedTypes) ? nullptr : found;
}

}  // namespace

ListedAs listedAs(std::int16_t resultType) noexcept {
  const ListedType* const row = findListed(resultType);
  return row == nullptr ? ListedAs::Counted : row->listedAs;
}

bool isKnownResultType(std::int16_t resultType) noexcept { return findListed(resultType) != nullptr; }

}  // namespace frontpanels
