// Annotation page: its two layouts, the callout size overrun, and the two
// dialogs of the newer dialog framework opened, ended every way, and outlived by their events.
#include "RecordingPages.h"

namespace {
class AnnotPage : public PageTest<RecordingAnnotPage> {
protected:
  // The newer dialog the page has open, if any.
  ZEPVidFraDialog* Dialog() {
    ZEPVidFraDialog* found = nullptr;
    for (ZEPVidFraWindow* w : ZEPVidFraWindow::Windows())
      if (w->GetParentCommand() == _pPage && !w->IsDestructionRequested())
        found = ZEPSysDynamicCast<ZEPVidFraDialog>(w);
    return found;
  }
  // Presses the button and answers the dialog it opened.
  ZEPVidFraDialog* Press(const char* iButton) {
    EXPECT_TRUE(Click(iButton)) << iButton;
    return Dialog();
  }
};

const char* const kButtons[] = {"pushTableSortCustomLists", "pushLegendTableLayout"};
} // namespace

TEST_F(AnnotPage, ModuleHooksBuildTheAnnotationLayout) {
  Open(); // its frames and the radio on are in the dump
  EXPECT_TRUE(_script.calls.empty());
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("annot_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(AnnotPage, TheCalloutInfoStatusChoosesTheLayout) {
  const struct {
    long status;
    bool callout;
  } cases[] = {{0, true}, {1, false}, {E_FAIL, false}, {E_NOTIMPL, false}};
  for (const auto& c : cases) {
    _script.info = {{"CalloutSizeOverrun", c.status}};
    Open();
    EXPECT_EQ(Find("toolCalloutCreation") != nullptr, c.callout) << c.status;
    EXPECT_EQ(Find("frmTable") != nullptr, !c.callout) << c.status;
    EXPECT_NE(Find("pushLegendTableLayout"), nullptr);
  }
  _script.info.clear();
  _script.allInfoSet = true; // every info hook answers 0: the callout layout
  Open();
  ExpectGolden("annot_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(AnnotPage, CalloutSizeOverrunIsAPaperLengthWrittenOnlyByTheUser) {
  _script.info = {{"CalloutSizeOverrun", 0}};
  _script.values = {{"CalloutSizeOverrun", {2.5}}, {"EnableCreateCallout", {1}}};
  Open();
  auto* spinner = Spinner("edtCalloutSizeOverrun");
  EXPECT_DOUBLE_EQ(spinner->GetValue(), 0.0025);
  EXPECT_TRUE(_script.calls.empty()) << "opening the page writes nothing";
  ASSERT_TRUE(ZEPDlgDriver::Enter(spinner, 0.004));
  ASSERT_TRUE(Click("chkEnableCreateCallout"));
  ASSERT_EQ(Hooks(), (std::vector<std::string>{"SetSysCalloutSizeOverrun", "SetSysEnableCreateCallout"}));
  EXPECT_DOUBLE_EQ(_script.calls[0].values[0], 4.0);
  EXPECT_EQ(_script.calls[1].values[0], 0.0);
}

TEST_F(AnnotPage, EveryCheckWritesItsOwnAttribute) {
  const char* const checks[][2] = {{"TextSnappingOn", "TextAlongRef"},
                                   {"TextLeadSnappingOn", "LeaderTextNormal"},
                                   {"GDTSnappingOn", "LeaderGDTNormal"},
                                   {"chkTableResize", "RecomputeTable"},
                                   {"chkTableAutoSplit", "PreventTableSplit"},
                                   {"chkAskForDelSupport", "AskForDelSupport"},
                                   {"checkTextRigidPosLink", "TextRigidPosLink"},
                                   {"checkTableRigidPosLink", "TableRigidPosLink"},
                                   {"checkGDTRigidPosLink", "GDTRigidPosLink"}};
  for (const auto& c : checks) _script.values[c[1]] = {1};
  Open();
  for (const auto& c : checks) {
    _script.calls.clear();
    EXPECT_TRUE(Checked(c[0])) << c[0];
    ASSERT_TRUE(Click(c[0]));
    ASSERT_EQ(Hooks(), std::vector<std::string>{std::string("SetSys") + c[1]});
    EXPECT_EQ(_script.calls[0].values[0], 0.0);
  }
}

TEST_F(AnnotPage, EachDialogOpensOnceAndEveryEndingFreesBothButtons) {
  _script.texts["LegendContext"] = "SheetLegend";
  const struct {
    const char* button;
    bool (*end)(ZEPVidFraDialog*);
  } cases[] = {{kButtons[0], &ZEPDlgDriver::Accept}, {kButtons[0], &ZEPDlgDriver::Cancel},
               {kButtons[0], &ZEPDlgDriver::Reject}, {kButtons[1], &ZEPDlgDriver::Accept},
               {kButtons[1], &ZEPDlgDriver::Cancel}, {kButtons[1], &ZEPDlgDriver::Reject}};
  Open();
  for (const auto& c : cases) {
    ZEPVidFraDialog* dialog = Press(c.button);
    ASSERT_NE(dialog, nullptr) << c.button;
    EXPECT_TRUE(dialog->IsVisible());
    EXPECT_EQ(dialog->GetLifeCycle(), 2);
    if (auto* legend = ZEPSysDynamicCast<ZEPDbsLegendTableLayoutVID>(dialog))
      EXPECT_EQ(legend->GetContext(), "SheetLegend");
    else
      EXPECT_TRUE(ZEPSysDynamicCast<ZEPDbsManageCustomListVID>(dialog->GetApplicativeWidget())->IsBuilt());
    // While it is open, neither button opens anything.
    for (const char* other : kButtons) EXPECT_EQ(Press(other), dialog);
    EXPECT_EQ(ZEPCheckLog::Count(), 2);
    EXPECT_TRUE(ZEPCheckLog::Contains("!_pFraDialog"));
    ZEPCheckLog::Clear();
    ASSERT_TRUE(c.end(dialog));
    EXPECT_FALSE(dialog->IsVisible());
    EXPECT_EQ(Dialog(), nullptr);
    EXPECT_FALSE(c.end(dialog)) << "an ending dialog takes no more clicks";
    ZEPDlgDriver::Idle();
    EXPECT_EQ(ZEPVidFraWindow::Windows().size(), 0u);
    EXPECT_EQ(ZEPCheckLog::Count(), 0) << c.button;
  }
  EXPECT_TRUE(_script.calls.empty());
}

TEST_F(AnnotPage, EventsAfterThePageIsGoneDoNothing) {
  for (const char* button : kButtons) {
    Open();
    ZEPVidFraDialog* dialog = Press(button);
    ASSERT_NE(dialog, nullptr);
    delete _pWindow; // the page goes with its dialog still open
    _pWindow = nullptr;
    // The host still has the dialog until idle time; its events find no page.
    ZEPSYPEventArgs args;
    dialog->Raise(ZEPVidFraDialog::RejectButtonClicked(), &args);
    dialog->Raise(ZEPVidFraWindow::Closed(), &args);
    if (ZEPVidWidget* panel = dialog->GetApplicativeWidget())
      panel->Raise(ZEPDbsManageCustomListVID::AcceptBtnPressed(), &args);
    EXPECT_FALSE(args.IsConsumed());
    EXPECT_EQ(ZEPCheckLog::Count(), 0);
    ZEPDlgDriver::Idle();
    EXPECT_TRUE(ZEPVidFraWindow::Windows().empty()) << "the page let its dialog go";
  }
}

TEST_F(AnnotPage, CloseEventWithoutArgumentsStillReleasesTheDialog) {
  Open();
  ZEPVidSetup::SetEventsWithoutArgs(true);
  for (const char* button : kButtons) {
    ZEPVidFraDialog* dialog = Press(button);
    ASSERT_NE(dialog, nullptr);
    ASSERT_TRUE(ZEPDlgDriver::Reject(dialog));
    EXPECT_TRUE(ZEPCheckLog::Contains("ipArgs"));
    EXPECT_TRUE(dialog->IsDestructionRequested());
    EXPECT_FALSE(dialog->IsVisible());
    ZEPCheckLog::Clear();
  }
  // Custom lists end through their own buttons too.
  for (bool (*end)(ZEPVidFraDialog*) : {&ZEPDlgDriver::Accept, &ZEPDlgDriver::Cancel}) {
    ZEPVidFraDialog* dialog = Press(kButtons[0]);
    ASSERT_NE(dialog, nullptr);
    ASSERT_TRUE(end(dialog));
    EXPECT_EQ(ZEPCheckLog::Entries().size(), 1u);
    EXPECT_TRUE(ZEPCheckLog::Contains("ipArgs"));
    EXPECT_EQ(Dialog(), nullptr);
    ZEPCheckLog::Clear();
  }
}

TEST_F(AnnotPage, HostFailuresAndPressesWithoutSenderAreReportedAndLeaveTheButtonsWorking) {
  const struct {
    void (*setup)(bool);
    const char* button;
    const char* reported;
  } cases[] = {{&ZEPVidSetup::SetCustomListFactoryFails, kButtons[0], "_pFraDialog"},
               {&ZEPVidSetup::SetLegendFactoryFails, kButtons[1], "_pFraDialog"},
               {&ZEPVidSetup::SetCustomListContentIsNotPanel, kButtons[0], "pPanel"}};
  Open();
  for (const auto& c : cases) {
    c.setup(true);
    EXPECT_EQ(Press(c.button), nullptr);
    ASSERT_EQ(ZEPCheckLog::Count(), 1);
    EXPECT_EQ(ZEPCheckLog::Entries()[0].expression, c.reported);
    EXPECT_EQ(ZEPCheckLog::Entries()[0].path, "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseOptAnnotFrm");
    ZEPCheckLog::Clear();
    c.setup(false);
    ZEPDlgDriver::Idle();
    EXPECT_TRUE(ZEPVidFraWindow::Windows().empty()) << "nothing kept of the failed opening";
    ZEPVidFraDialog* dialog = Press(c.button);
    ASSERT_NE(dialog, nullptr) << "a later press works";
    ASSERT_TRUE(ZEPDlgDriver::Reject(dialog));
    EXPECT_EQ(ZEPCheckLog::Count(), 0);
  }
  // A press notified without a sender is reported too, and opens nothing.
  ZEPDlgDriver::Idle();
  ZEPDialog* push = Control(kButtons[0]);
  push->DeliverAs(ZEPSysDynamicCast<ZEPDlgPushButton>(push)->GetPushBActivateNotification(), nullptr);
  EXPECT_TRUE(ZEPCheckLog::Contains("iFrom"));
  EXPECT_EQ(Dialog(), nullptr);
}
