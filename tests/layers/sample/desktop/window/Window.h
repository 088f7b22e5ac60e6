#pragma once
#include "host/document/Document.h"
#include <QWidget>
