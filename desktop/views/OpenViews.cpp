#include "desktop/views/OpenViews.h"

#include "desktop/texts/Texts.h"
#include "host/session/ViewFrame.h"

namespace quarn::desktop {

namespace {

KM_SimpleArray<CQuarnView*> viewsOf(CQuarnDoc& document) {
    KM_SimpleArray<CQuarnView*> views;
    document.GetViewList(views, true, false);
    return views;
}

QString nameOf(CQuarnView& view) {
    return qtText(view.MainViewport().Name());
}

} // namespace

QStringList viewNames(CQuarnDoc& document) {
    QStringList names;
    const auto views = viewsOf(document);
    for (int i = 0; i < views.Count(); ++i)
        names.append(nameOf(*views[i]));
    return names;
}

CQuarnView* findView(CQuarnDoc& document, const QString& name) {
    const auto views = viewsOf(document);
    for (int i = 0; i < views.Count(); ++i)
        if (nameOf(*views[i]) == name)
            return views[i];
    return nullptr;
}

QString activeViewName(CQuarnDoc& document) {
    return nameOf(activeView(document));
}

} // namespace quarn::desktop
