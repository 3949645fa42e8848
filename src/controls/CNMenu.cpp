// What the two kinds of menus have of their own.
#include "controls/MenuKinds.h"

void CNRightMenu::ReadText(ScriptCursor& cursor, ScriptContext& context) {
  m_csControl = static_cast<CNString&&>(m_csName);
  CNBaseMenu::ReadText(cursor, context);
}

void CNRightMenu::WriteText(CNString& csOut) const {
  if (m_csControl.Ptr()) {
    csOut.Concat(" '");
    csOut.Concat(m_csControl.Ptr());
    csOut.Concat("'");
  }
  CNBaseMenu::WriteText(csOut);
}
