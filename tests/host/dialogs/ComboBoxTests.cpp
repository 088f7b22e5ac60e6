#include "sdk/qncore/QnComboBox.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

/// What was done to a control; it outlives the control.
struct Record {
    std::vector<std::wstring> entries;
    int selection = -1;
    int destroyed = 0;
};

class RecordedControl final : public IQnComboBoxControl {
public:
    explicit RecordedControl(Record& record) : m_record(record) {}
    ~RecordedControl() override { ++m_record.destroyed; }
    void Reset() override {
        m_record.entries.clear();
        m_record.selection = -1;
    }
    int Count() const override { return static_cast<int>(m_record.entries.size()); }
    void Insert(int index, const wchar_t* text) override {
        m_record.entries.insert(m_record.entries.begin() + index, text);
    }
    void Select(int index) override { m_record.selection = index; }
    int Selection() const override { return m_record.selection; }

private:
    Record& m_record;
};

class ComboBox : public ::testing::Test {
protected:
    void attach() { combo_box.SetControl(std::make_unique<RecordedControl>(record)); }
    void fill() {
        attach();
        for (const wchar_t* text : {L"a", L"b", L"c"})
            combo_box.InsertString(-1, text);
    }

    Record record;
    CComboBox combo_box;
};

using Texts = std::vector<std::wstring>;

} // namespace

TEST_F(ComboBox, WithoutAControlIsEmptyAndIgnoresChanges) {
    EXPECT_FALSE(combo_box.HasControl());
    EXPECT_EQ(-1, combo_box.InsertString(0, L"a"));
    EXPECT_EQ(-1, combo_box.SetCurSel(0));
    combo_box.ResetContent();
    EXPECT_EQ(0, combo_box.GetCount());
    EXPECT_EQ(-1, combo_box.GetCurSel());
}

TEST_F(ComboBox, InsertsAtTheIndexOrBehindTheLast) {
    attach();
    EXPECT_EQ(0, combo_box.InsertString(0, L"b"));
    EXPECT_EQ(0, combo_box.InsertString(0, L"a"));
    EXPECT_EQ(2, combo_box.InsertString(2, L"d"));
    EXPECT_EQ(2, combo_box.InsertString(2, L"c"));
    EXPECT_EQ(4, combo_box.InsertString(-1, L"e"));
    EXPECT_EQ(Texts({L"a", L"b", L"c", L"d", L"e"}), record.entries);
    EXPECT_EQ(5, combo_box.GetCount());
}

TEST_F(ComboBox, RefusesPlacesBehindTheEndAndTextsThatAreNone) {
    fill();
    EXPECT_EQ(-1, combo_box.InsertString(4, L"x"));
    EXPECT_EQ(-1, combo_box.InsertString(-2, L"x"));
    EXPECT_EQ(-1, combo_box.InsertString(0, nullptr));
    EXPECT_EQ(Texts({L"a", L"b", L"c"}), record.entries);
}

TEST_F(ComboBox, SelectsAnEntryAndNoneForAnIndexOutsideTheList) {
    fill();
    EXPECT_EQ(2, combo_box.SetCurSel(2));
    EXPECT_EQ(2, combo_box.GetCurSel());
    EXPECT_EQ(-1, combo_box.SetCurSel(3));
    EXPECT_EQ(-1, combo_box.GetCurSel());
    EXPECT_EQ(0, combo_box.SetCurSel(0));
    EXPECT_EQ(-1, combo_box.SetCurSel(-5));
    EXPECT_EQ(-1, record.selection);
}

TEST_F(ComboBox, IsEmptyAfterReset) {
    fill();
    combo_box.SetCurSel(1);
    combo_box.ResetContent();
    EXPECT_EQ(0, combo_box.GetCount());
    EXPECT_EQ(-1, combo_box.GetCurSel());
}

TEST_F(ComboBox, ReleasesTheControlThatItHadForANewOneAndForNone) {
    attach();
    Record second;
    combo_box.SetControl(std::make_unique<RecordedControl>(second));
    EXPECT_EQ(1, record.destroyed);
    EXPECT_EQ(0, second.destroyed);
    combo_box.SetControl(nullptr);
    EXPECT_EQ(1, second.destroyed);
    EXPECT_FALSE(combo_box.HasControl());
}

TEST_F(ComboBox, ReleasesItsControlWhenItGoes) {
    {
        CComboBox short_lived;
        short_lived.SetControl(std::make_unique<RecordedControl>(record));
    }
    EXPECT_EQ(1, record.destroyed);
}
