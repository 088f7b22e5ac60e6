#pragma once
#include <QWidget>
#include "sdk/qncore/QnDoc.h"
#include "zoetrix/ui/TurnTableDialog.h"
