#include <cstring>

#include "InstallerRun.h"

TEST(CarriedScripts, FixedPagesKeepEveryLetter) {
  EXPECT_EQ(ReadSource("src/installer/scripts/please_wait.txt"),
            "DIALOG1 DIALOG \" Setup\" 200 200 500 100,BACKGROUND(227,241,228),CENTER,NO_LOGPIXELS\n"
            "\"Arial\" 15 500\n"
            "BEGIN\n"
            "  TEXT_FIELD 'txt1' \"Please wait while Setup prepares the Installation Wizard.\" 0 25 494 "
            "18,BACKGROUND(227,241,228),ACENTER,NO_LOGPIXELS\n"
            "  START_AFTER_DRAWING\n"
            "    START_ACTION\n"
            "      ExpandStream ()\n"
            "    FINISH_ACTION\n"
            "END\n"
            "END_DIALOG1\n");
  EXPECT_EQ(ReadSource("src/installer/scripts/exit.txt"),
            "DIALOG1 'dlg1' \" Exit Setup\" 200 200 320 200,BACKGROUND(227,241,228),CENTER,NO_LOGPIXELS\n"
            "\"Arial\" 15 500\n"
            "BEGIN\n"
            "  BUTTON 'b_resume' \"Resume\" ID_CANCEL 56 140 75 23,BACKGROUND(227,241,228),NO_LOGPIXELS\n"
            "  BUTTON 'b_exit' \"Exit Setup\" 188 140 75 "
            "23,DEFAULT,FOCUS,NO_LOGPIXELS,BACKGROUND(227,241,228) ACTION\n"
            "  TEXT_FIELD 'txt1' \"Setup is not complete. If you quit the Setup program now, the program will not be "
            "installed.\" 15 10 300 30,BACKGROUND(227,241,228),NO_LOGPIXELS\n"
            "  TEXT_FIELD 'txt2' \"You may run the Setup program at a later time to complete the installation.\" 15 50 "
            "300 30,BACKGROUND(227,241,228),NO_LOGPIXELS\n"
            "  TEXT_FIELD 'txt3' \"To continue installing the program, click 'Resume'. To quit the Setup program, "
            "click 'Exit Setup'.\" 15 90 300 30,BACKGROUND(227,241,228),NO_LOGPIXELS\n"
            "END\n"
            "END_DIALOG1\n");
}

class InstallerScript : public testing::Test {
 protected:
  void SetUp() override {
    ASSERT_EQ(m_wizard.iLoadMainList(ReadSource("src/installer/scripts/installer.txt").c_str()), 0);
  }

  HeadlessView m_view;
  COrbitWizard m_wizard{m_view};
};

TEST_F(InstallerScript, HasSixteenVariablesInOrder) {
  std::string text;
  for (int i = 1; i < m_wizard.Variables().Size(); i++)  // the first is the engine's own
    text += std::string(m_wizard.Variables()[i]->csName.Text()) + "=" + m_wizard.Variables()[i]->csValue.Text() + ";";
  EXPECT_EQ(text,
            "msgbox_capt=Setup;no_space1=You do not have enough place on your ;no_space2=: drive.\nPlease exit the "
            "Setup program and free ;no_space3= KB of space on your hard disk.;create_dir1=The "
            "directory:\n\n';create_dir2='\n\ndoes not exist. Do you want the directory to be "
            "created?;default_path=Tavola\\Plumo;program_name=Plumo;program_folder=Plumo;program_file=Plumo.exe;dict_"
            "path=none;uninstall=UnInstall01.exe;colvane_file=Plumo.exe;colvane_link=Plumo.lnk;quick_launch=1;desktop_"
            "shortcut=1;");
}

TEST_F(InstallerScript, HasSixPagesWithoutFaults) {
  ASSERT_EQ(m_wizard.DialogCount(), 6);
  for (int i = 1; i <= 6; i++) {
    const DialogInfo& dialog = *m_wizard.GetDialog(i);
    EXPECT_EQ(std::string(dialog.m_csName.Text()), "PL-dlg" + std::to_string(i));
    EXPECT_EQ(dialog.m_Kind, DialogKind::DialogSys);
    EXPECT_STREQ(dialog.m_Font.csFace.Text(), "Arial");
    EXPECT_EQ(dialog.m_Font.iHeight, 15);
    EXPECT_EQ(dialog.m_Font.iWeight, 500);
    EXPECT_EQ(strstr(dialog.m_csFlow.Text(), "CONTINUE") != nullptr, i != 6);
  }
  EXPECT_TRUE(m_view.events.empty()) << m_view.events.front();
}

static bool bPaintsBackground(const BaseControl& control) {
  return control.Kind() == ControlKind::Button || control.Kind() == ControlKind::Static ||
         control.Kind() == ControlKind::CheckBox;
}

TEST_F(InstallerScript, IsLightGreenAndUnscaledThroughout) {
  const auto bGreen = [](const ControlColor& c) { return c.bSet && c.red == 227 && c.green == 241 && c.blue == 228; };
  for (int i = 1; i <= 6; i++) {
    const DialogInfo& dialog = *m_wizard.GetDialog(i);
    EXPECT_TRUE(bGreen(dialog.m_Background));
    EXPECT_TRUE(dialog.m_bNoScaling);
    for (int n = 0; n < dialog.m_Controls.Size(); n++) {
      const BaseControl& control = *dialog.m_Controls[n];
      const std::string name = std::string(dialog.m_csName.Text()) + " " + control.m_csName.Text();
      EXPECT_EQ(bGreen(control.m_Background), bPaintsBackground(control)) << name;
      EXPECT_TRUE(control.Kind() == ControlKind::MsgBox || control.bHasFlag("NO_LOGPIXELS")) << name;
    }
  }
}
