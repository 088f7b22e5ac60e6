#include "zoetrix/commands/EndWith.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"

int EndWith(const wchar_t* text, int id, int ended) {
    QuarnApp().Print(QnLocalizeString(text, id));
    return ended;
}
