#include "sdk/cocoa/QXPopUpButton.h"

#include "sdk/cocoa/QXText.h"

namespace {

class PopUpControl final : public IQnComboBoxControl {
public:
    explicit PopUpControl(NSPopUpButton* button) : m_button([button retain]) {}
    ~PopUpControl() override { [m_button release]; }
    PopUpControl(const PopUpControl&) = delete;
    PopUpControl& operator=(const PopUpControl&) = delete;

    void Reset() override { [m_button removeAllItems]; }
    int Count() const override { return static_cast<int>([m_button numberOfItems]); }

    // Not through the button: that drops an entry whose title another one has already.
    void Insert(int index, const wchar_t* text) override {
        [[m_button menu] insertItemWithTitle:[NSString stringWithLPCTSTR:text]
                                      action:nullptr
                               keyEquivalent:@""
                                     atIndex:index];
    }

    void Select(int index) override {
        [m_button selectItemAtIndex:index];
        [m_button synchronizeTitleAndSelectedItem];
    }
    int Selection() const override { return static_cast<int>([m_button indexOfSelectedItem]); }

private:
    NSPopUpButton* m_button;
};

} // namespace

std::unique_ptr<IQnComboBoxControl> QXMakePopUpControl(NSPopUpButton* button) {
    if (!button) {
        return nullptr;
    }
    return std::make_unique<PopUpControl>(button);
}
