#include "controls/ItemKinds.h"

CNStatusBar::CNStatusBar() : CNTextList(ControlKind::StatusBar) { m_dwStyle &= ~STYLE_TABSTOP; }
