#include "activex/cell_name_object.h"

#include <gtest/gtest.h>

#include "activex/constituent_object.h"
#include "platform/control_set.h"
#include "tests/wine/full_container.h"

namespace frontpanels::activex {
namespace {

TEST(CellNameObjectTest, ControlsShareTheNamesBehindTheHostsObject) {
  auto object = ComPointer<IUnknown>::adopt((new CellNameObject(nullptr))->inner());
  const auto names = cellNamesOf(object.query<IDispatch>().get());
  ASSERT_NE(names, nullptr);
  object.query<IclsCellNameInfo>()->SetCellName(5, 7, nullptr);
  EXPECT_EQ(names->GetCellName(5, -1), "");
  object.reset();
  EXPECT_EQ(names.use_count(), 1);
  EXPECT_EQ(moduleLocks(), 0);
}

TEST(CellNameObjectTest, OtherObjectsHaveNone) {
  EXPECT_EQ(cellNamesOf(nullptr), nullptr);
  constexpr ControlRow kRows[] = {{"SpanLabel", ControlKind::Label, "", "S&pan", {}}};
  const ControlSet controls(kRows);
  const auto label =
      ComPointer<IDispatch>::adopt(new ConstituentObject(nullptr, controls.control("SpanLabel")));
  EXPECT_EQ(cellNamesOf(label.get()), nullptr);
}

TEST(CellNameObjectTest, PartOfAnAggregateItAnswersForTheWhole) {
  struct Outer final : testing::Counted<IUnknown> {
    CellNameObject* part = nullptr;
    void* find(REFIID id) override {
      if (id == IID_IUnknown) return this;
      void* found = nullptr;
      if (part->inner()->QueryInterface(id, &found) == S_OK) Release();  // the caller counts it again
      return found;
    }
  } outer;
  CellNameObject part(&outer);
  outer.part = &part;
  EXPECT_EQ(cellNamesOf(&outer), part.cellNames());
  EXPECT_EQ(outer.references, 1);
}

}  // namespace
}  // namespace frontpanels::activex
