#include "controls/ContainerKinds.h"

const SimpleKind g_CNGroupBox = {
    ControlKind::GroupBox, "GROUP_BOX",           "CNGroupBox", "BUTTON", STYLE_BS_GROUPBOX | STYLE_CLIPCHILDREN,
    STYLE_TABSTOP,         STYLE_EX_CONTROLPARENT};
