// Items that are chosen and keys that are pressed: their commands, ticks and choices.
#include "WizardFixture.h"
#include "controls/MenuKinds.h"

namespace {

class Items : public WizardTest {};

TEST_F(Items, TicksAndChoicesHoldAtOnceAndComeBack) {
  const std::string bars =
      "MENU_BAR\nMENU \"View\"\nITEM 'DoShow' \"Of <%who%>\",VAR(shown)\nEND_MENU\nEND_MENUBAR\n"
      "TOOLBAR 'bar' 0 0 0 0\nCOMBO 'DoSize' \"8\" \"10\" 60\nITEM 'DoTick' \"T\",VAR(new)\nEND_TOOLBAR\n";
  Run("INIT\nshown = \"1\"\nDoSize = \"10\"\nwho = \"Ana\"\nEND_INIT\n" + Dialog("a", bars, "CONTINUE\n") +
          Dialog("b", bars, ""),
      {[&] {
        const CNItemControl* pMenu = view.Dialog()->m_Controls[0]->pItemControl();
        const CNItemControl* pBar = view.Dialog()->m_Controls[1]->pItemControl();
        bool bTicked = false;
        EXPECT_TRUE(view.bIsItemChecked(*pMenu, 1, bTicked) && bTicked);
        EXPECT_STREQ(pBar->m_Items[0]->m_csCaption.Text(), "10");
        EXPECT_TRUE(view.bChooseItem("DoShow"));
        EXPECT_EQ(wizard.Value("shown"), "0");
        EXPECT_TRUE(view.bIsItemChecked(*pMenu, 1, bTicked) && !bTicked);
        EXPECT_TRUE(view.bChooseItem("DoTick"));
        EXPECT_EQ(wizard.Value("new"), "1");
        pBar->m_Items[0]->m_csCaption = "8";
        EXPECT_TRUE(view.bChooseItem("DoSize"));
        EXPECT_EQ(wizard.Value("DoSize"), "8");
        EXPECT_EQ(wizard.ran, (Lines{"DoShow()", "DoTick()", "DoSize()"}));
        wizard.OnCommand(ID_NEXT);
        pMenu = view.Dialog()->m_Controls[0]->pItemControl();
        EXPECT_TRUE(view.bIsItemChecked(*pMenu, 1, bTicked) && !bTicked) << "the next page shows the same";
        EXPECT_STREQ(view.Dialog()->m_Controls[1]->pItemControl()->m_Items[0]->m_csCaption.Text(), "8");
      }});
}

TEST_F(Items, TheWizardsKeysHoldInEveryDialogAndWin) {
  Run(Dialog("a", "ACCELERATOR \"F5\" ACTION: (DoOwn (a))\nACCELERATOR 'DoKey' \"Ctrl+K\" ACTION: (x)\n",
             "CONTINUE\n") +
          Dialog("b", "GLOBAL_ACCELERATOR \"F5\" ACTION: (DoAll ())\nACCELERATOR \"F6\" ACTION: (DoOwn (b))\n", ""),
      {[&] {
        const int iF5 = 0x74, iF6 = 0x75;
        EXPECT_EQ(wizard.iTranslateKeyAccelerators(iF5, 0), 0);
        EXPECT_EQ(wizard.iTranslateKeyAccelerators(iF5, KEY_SHIFT), 9);
        EXPECT_EQ(wizard.iTranslateKeyAccelerators('K', KEY_CTRL), 0);
        EXPECT_EQ(wizard.iTranslateKeyAccelerators(iF6, 0), 9) << "a key of another dialog";
        wizard.OnCommand(ID_NEXT);
        EXPECT_EQ(wizard.iTranslateKeyAccelerators(iF6, 0), 0);
        EXPECT_TRUE(view.bChooseItem("F5")) << "pressed by its name";
        EXPECT_EQ(wizard.iTranslateKeyAccelerators('K', KEY_CTRL), 9);
        EXPECT_EQ(wizard.ran, (Lines{"DoAll()", "DoKey(x)", "DoOwn(b)", "DoAll()"}));
      }});
  EXPECT_EQ(wizard.iTranslateKeyAccelerators('K', KEY_CTRL), 1) << "without a window";
}

// What a person does to a list view and a header, and what of it the script sees.
TEST_F(Items, CellsTicksAndHeadings) {
  const std::string page =
      "FRAME 'f' 0 0 9 9\nLISTVIEW 'Do_l' 1 2 3 4,CHECKBOX ACTION: ()\nCOLUMN \"c\" 9,EDIT\nCOLUMN \"p\" 9,PROGRESS\n"
      "ITEM \"<RGB(1,2,3)><%cell%>\" \"<%bar%>\" TOOLTIP 'Now <%cell%>',VAR(tick)\n"
      "ITEM \"<%same%>\" \"\",DISABLE,VAR(off)\nEND_LISTVIEW\nEND_FRAME\n"
      "HEADER 'Do_h' \"one\" 1 2 3 4,BUTTONS ACTION: ()\nHEADER 'still' \"one\" 1 2 3 4 ACTION: ()\n";
  Run("INIT\ncell = \"a\"\nbar = \"5\"\nsame = \"<%bar%>\"\nEND_INIT\n" + Dialog("a", page, "CONTINUE\n") +
          Dialog("b", "", ""),
      {[&] {
        const CNItem& row = *view.Dialog()->GetBaseControl("Do_l")->pItemControl()->m_Items[2];
        EXPECT_STREQ(row.m_csShownToolTip.Text(), "Now a");
        EXPECT_TRUE(view.bType("cell", "b"));
        EXPECT_FALSE(view.bType("bar", "6")) << "nobody edits a bar";
        EXPECT_FALSE(view.bType("same", "6")) << "a grey row";
        EXPECT_TRUE(view.bTick("tick", true));
        EXPECT_FALSE(view.bTick("off", true));
        EXPECT_TRUE(view.bChooseItem("b")) << "known by what it shows";
        EXPECT_TRUE(view.bSelect("Do_h", "one"));
        EXPECT_FALSE(view.bSelect("still", "one"));
        EXPECT_EQ(wizard.ran,
                  (Lines{"Do_l_OnEditChange()", "Do_l_OnSelChange()", "Do_l_OnDoubleClick()", "Do_h_OnClick()"}));
        EXPECT_EQ(wizard.Value("cell"), "a") << "not yet saved";
        wizard.OnCommand(ID_NEXT);
        EXPECT_EQ(wizard.Value("cell"), "b");
        EXPECT_EQ(wizard.Value("same"), "<%bar%>") << "not edited, not filled in";
        EXPECT_EQ(wizard.Value("tick"), "1");
        wizard.OnCommand(ID_BACK);
        EXPECT_STREQ(row.m_csShownToolTip.Text(), "Now b");
        view.bEnable(*view.Dialog()->GetBaseControl("f"), false);
        EXPECT_FALSE(view.bType("cell", "c")) << "it goes with its frame";
        EXPECT_FALSE(view.bChooseItem("b"));
      }});
}

}  // namespace
