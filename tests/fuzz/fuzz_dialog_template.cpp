// Dialog templates. Whatever the text, it is refused with a reason or makes a form whose controls
// can be told apart and can all be used.
#include "host/dialogs/DialogTemplates.h"
#include "host/front_end/HeadlessDialogWindow.h"

#include <cstdint>
#include <cstdlib>
#include <set>
#include <string_view>

namespace {

using namespace quarn;

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

void checkControls(const DialogTemplate& form) {
    constexpr int last_reserved_id = 2; // of OK and Cancel
    constexpr std::size_t most_controls = 200;
    std::set<int> ids;
    for (const DialogControl& control : form.controls) {
        require(control.id > last_reserved_id && ids.insert(control.id).second);
        require(!control.label.IsEmpty());
    }
    require(ids.size() <= most_controls);
    require(form.controls.empty() || !form.controls.front().joins_row);
}

void use(const DialogTemplate& form) {
    HeadlessDialogWindow window(form, {});
    for (const DialogControl& control : form.controls) {
        require(window.hasControl(control.id));
        window.setText(control.id, L"1");
        window.focus(control.id);
        const bool is_list = control.kind == DialogControl::Kind::combo_box;
        require((window.comboBox(control.id) != nullptr) == is_list);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const StringTables no_texts("C");
    const Result<DialogTemplate> form =
        readDialogTemplateText({reinterpret_cast<const char*>(bytes), size}, no_texts);
    if (!form) {
        require(!form.message().empty());
        return 0;
    }
    require(form.value().id > 0 && !form.value().title.IsEmpty());
    checkControls(form.value());
    use(form.value());
    return 0;
}
