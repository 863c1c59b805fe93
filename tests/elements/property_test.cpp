#include "elements/property.h"

#include <gtest/gtest.h>

#include <string>

namespace tessal {
namespace {

class CountingHolder final : public PropertyHolder {
 public:
  explicit CountingHolder(bool& modified) { SetFlag(&modified); }
  void OnPropertyChanged(CEL_Property& /*changed*/) override { heard += 'h'; }
  void OnTableChanged() override { heard += 't'; }
  std::string heard;
};

class CountingListener final : public PropertyListener {
 public:
  void OnPropertyChanged(CEL_Property& /*changed*/) override { ++calls; }
  int calls = 0;
};

TEST(Property, ChangesKeepTheOldValueAndTellWhoListens) {
  bool modified = false;
  CountingHolder holder(modified);
  CountingListener listener;
  CEL_Property text(ValueType::Text);
  text.BelongTo(holder);
  text.AddListener(listener);
  text.AddListener(listener);
  SetNotifyChanges(true);
  EXPECT_TRUE(text.SetText(""));
  EXPECT_FALSE(modified) << "the present value is no change";
  EXPECT_TRUE(text.SetText("new"));
  EXPECT_TRUE(modified);
  EXPECT_EQ(listener.calls, 1);
  EXPECT_EQ(text.PrevText(), "");
  EXPECT_EQ(holder.heard, "") << "nobody has said that it reports to the holder";
  {
    const NotificationsOff silent;
    modified = false;
    text.SetText("silent");
    EXPECT_TRUE(modified);
    EXPECT_EQ(listener.calls, 1);
  }
  text.SetText(text.Text().substr(1));
  EXPECT_EQ(listener.calls, 2);
  EXPECT_EQ(text.PrevText(), "silent");
  text.SetText("");
  text.ReportTo(ReportsTo::Table);
  text.SetText("again");
  EXPECT_EQ(text.PrevText(), "");
  text.ReportTo(ReportsTo::Holder);
  text.StartWithText("of a file");
  EXPECT_EQ(holder.heard, "t") << "what a file gives is nobody's change";
  EXPECT_EQ(text.PrevText(), "");
  text.SetText("last");
  EXPECT_EQ(holder.heard, "th");
  EXPECT_EQ(text.PrevText(), "of a file");
  SetNotifyChanges(false);
}

TEST(Property, TakesValuesOfItsTypeOnly) {
  CEL_Property real(ValueType::Real);
  CEL_Property integer(ValueType::Integer);
  CEL_Property boolean(ValueType::Boolean);
  EXPECT_FALSE(real.SetText("1"));
  EXPECT_FALSE(integer.SetReal(1.0));
  EXPECT_FALSE(boolean.SetInt(1));
  EXPECT_TRUE(real.SetReal(0.1));
  EXPECT_TRUE(integer.SetInt(-7));
  EXPECT_TRUE(boolean.SetBool(true));
  EXPECT_EQ(real.TextOf() + " " + integer.TextOf() + " " + boolean.TextOf(), "0.1 -7 YES");
  EXPECT_NE(real.ChangeStamp(), integer.ChangeStamp());
  EXPECT_EQ(real.ChangeStamp(), real.ChangeStamp());
}

TEST(Property, ChoicesAreSharedUntilOneIsAdded) {
  const ChoiceList shared = std::make_shared<const std::vector<CEL_Choice>>(
      std::vector<CEL_Choice>{CEL_Choice::Text("shown", "STORED"), CEL_Choice::Text("shown", "SECOND")});
  CEL_Property first(ValueType::Text);
  CEL_Property second(ValueType::Text);
  first.SetChoices(shared);
  second.SetChoices(shared);
  first.AddChoice(CEL_Choice::Text("own", "OWN"));
  EXPECT_TRUE(first.HasChoice("own"));
  EXPECT_FALSE(second.HasChoice("own"));
  second.SelectChoice("shown");
  second.ApplySelection();
  EXPECT_EQ(second.Text(), "STORED") << "the first of equals wins";
  EXPECT_EQ(second.SelectedFileText(), "STORED");
  second.SelectChoice("nothing");
  second.ApplySelection();
  EXPECT_EQ(second.Selected(), -1);
  EXPECT_EQ(second.Text(), "STORED");
  second.SelectIndex(5);
  EXPECT_THROW(second.ApplySelection(), std::out_of_range);
}

}  // namespace
}  // namespace tessal
