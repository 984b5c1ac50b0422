// Sketcher settings adapter: defaults, normalisation, per-range writes, notifications, failures.
#include "TestSupport.h"

#include "ZEP2DBaseSketcherSettingsAdapt.h"

#include <array>
#include <variant>

namespace {
using Adapt = ZEP2DBaseSketcherSettingsAdapt;
using Rgb = std::array<unsigned int, 3>;
using Values = std::vector<double>;

class TestAdapter : public Adapt {
public:
  void UseRepositories(ZEPSysSettingRepository* iGeneral, ZEPSysSettingRepository* iSpecific) {
    _pSettRep = iGeneral;
    _pSpecificSettRep = iSpecific;
  }
  unsigned int _uDefaultDiag = 0x123456;

protected:
  unsigned int GetDefaultColorDiagElts(ZEP2DCstDiag) override { return _uDefaultDiag; }
};

// What an attribute holds, whatever its stored type.
Values Stored(const ZEPSysSettingRepository* iRep, const std::string& iName) {
  Values out;
  if (const auto* v = iRep->Effective(iName))
    std::visit(
        [&](const auto& vec) {
          if constexpr (std::is_arithmetic_v<typename std::decay_t<decltype(vec)>::value_type>)
            out.assign(vec.begin(), vec.end());
        },
        *v);
  return out;
}

struct Event {
  std::string name;
  void* data;
  ZEPNotification* notif;
  Values storedAtDispatch; // the watched attribute when the event arrived
};

class SketcherAdapter : public ZEPHostTest {
public:
  void SetUp() override {
    ZEPHostTest::SetUp();
    _pGeneral = ZEPSysSettingRepository::Open("SketcherGeneral");
    _pSpecific = ZEPSysSettingRepository::Open("SketcherSpecific");
    for (const char* name : {Adapt::MultiModification(), Adapt::GridModification(), Adapt::GeomUIModification(),
                             Adapt::SnapModification(), Adapt::Visu3DUIModification(), Adapt::CpltModification()})
      _adapter.AddCallback(name, [this](const char* iName, ZEPNotification* iNotif, void* iData) {
        _events.push_back({iName, iData, iNotif, _pWatched ? Stored(_pWatched, _watched) : Values{}});
      });
  }
  void Connect() { _adapter.UseRepositories(_pGeneral, _pSpecific); }

  TestAdapter _adapter;
  ZEPSysSettingRepository* _pGeneral = nullptr;
  ZEPSysSettingRepository* _pSpecific = nullptr;
  std::vector<Event> _events;
  const ZEPSysSettingRepository* _pWatched = nullptr;
  std::string _watched;
};

struct ScalarRow {
  const char* attr;
  bool specific;
  int readDefault;
  int (Adapt::*get)();
  void (Adapt::*set)(int, int);
  const char* (*event)();
};

// Every int setting; the forwarding operations appear with the attribute they end up in.
// clang-format off
const ScalarRow kScalars[] = {
  {"Drw_settings_GridDisplay", true, 1, &Adapt::GetGridVisuMode, &Adapt::SetGridVisuMode, &Adapt::GridModification},
  {"Drw_settings_GridSnapPt", true, 1, &Adapt::GetGridSnapMode, &Adapt::SetGridSnapMode, &Adapt::SnapModification},
  {"Drw_settings_CreateCenter", false, 1, &Adapt::GetCreateCenter, &Adapt::SetCreateCenter, &Adapt::GeomUIModification},
  {"Drw_settings_CpltPosSupport", false, 1, &Adapt::GetPosSupports, &Adapt::SetPosSupports, &Adapt::CpltModification},
  {"Drw_settings_CpltPosHorVertTo", false, 1, &Adapt::GetPosHorVertTo, &Adapt::SetPosHorVertTo, &Adapt::CpltModification},
  {"Drw_settings_CpltDirHorVert", false, 1, &Adapt::GetDirHorVert, &Adapt::SetDirHorVert, &Adapt::CpltModification},
  {"Drw_settings_CpltDirParPerpTan", false, 1, &Adapt::GetDirParaPerpTan, &Adapt::SetDirParaPerpTan, &Adapt::CpltModification},
  {"Drw_settings_CpltDirParPerpTan", false, 1, &Adapt::GetDirParallel, &Adapt::SetDirParallel, &Adapt::CpltModification},
  {"Drw_settings_CpltDirParPerpTan", false, 1, &Adapt::GetDirPerpend, &Adapt::SetDirPerpend, &Adapt::CpltModification},
  {"Drw_settings_CpltDirParPerpTan", false, 1, &Adapt::GetDirTangent, &Adapt::SetDirTangent, &Adapt::CpltModification},
  {"Drw_settings_DragWithEndPts", false, 1, &Adapt::GetDragWithEndPts, &Adapt::SetDragWithEndPts, &Adapt::GeomUIModification},
  {"Drw_settings_DragModeR14", false, 1, &Adapt::GetDragMode, &Adapt::SetDragMode, &Adapt::GeomUIModification},
  {"Drw_settings_DragElts", false, 1, &Adapt::GetDragElts, &Adapt::SetDragElts, &Adapt::GeomUIModification},
  {"Drw_settings_DiagElts", true, 1, &Adapt::GetDiagElts, &Adapt::SetDiagElts, &Adapt::GeomUIModification},
  {"Drw_settings_ShowPosition", false, 0, &Adapt::GetShowPosition, &Adapt::SetShowPosition, &Adapt::CpltModification},
};
// clang-format on

ZEPCkeScale Range(int iRange) { return static_cast<ZEPCkeScale>(iRange); }

} // namespace

TEST_F(SketcherAdapter, DefaultsWithoutAndWithEmptyRepositories) {
  const Rgb diag[4] = {{255, 0, 255}, {255, 0, 0}, {128, 0, 0}, {0, 255, 0}};
  for (bool connected : {false, true}) {
    SCOPED_TRACE(connected ? "empty repositories" : "no repositories");
    if (connected) Connect();
    for (const ScalarRow& row : kScalars) {
      ZEPCheckLog::Clear();
      EXPECT_EQ((_adapter.*row.get)(), row.readDefault) << row.attr;
      EXPECT_EQ(ZEPCheckLog::Count(), 1) << row.attr; // the missing repository, or the failed read
      if (!connected) {
        EXPECT_TRUE(ZEPCheckLog::Contains(row.specific ? "_pSpecificSettRep" : "_pSettRep"));
      }
    }
    Rgb c{};
    _adapter.GetColorSmartPick(&c[0], &c[1], &c[2]);
    EXPECT_EQ(c, (Rgb{67, 102, 85}));
    _adapter.GetColorConstructElts(&c[0], &c[1], &c[2]);
    EXPECT_EQ(c, (Rgb{140, 140, 140}));
    // The four known diagnoses take the table's colours, not the subclass default.
    for (int d = 1; d <= 4; ++d) {
      _adapter.GetColorDiagElts(static_cast<ZEP2DCstDiag>(d), &c[0], &c[1], &c[2]);
      EXPECT_EQ(c, diag[d - 1]) << d;
    }
  }
  EXPECT_TRUE(ZEPCheckLog::Contains("3==_pSettRep->ReadAttr(mstrColorSmartPick, tab, 3)"));
  EXPECT_TRUE(ZEPCheckLog::Contains("3==_pSpecificSettRep->ReadAttr(pName, tab, 3)"));
  ZEPCheckLog::Clear();
  EXPECT_EQ(_adapter.GetDragMode(), 1);
  EXPECT_TRUE(ZEPCheckLog::Contains("1==_pSettRep->ReadAttr(mstrDragMode, &val)"));
}

TEST_F(SketcherAdapter, ScalarSettersNormaliseWriteAndNotifyOnce) {
  Connect();
  for (const ScalarRow& row : kScalars) {
    SCOPED_TRACE(row.attr);
    ZEPSysSettingRepository* rep = row.specific ? _pSpecific : _pGeneral;
    _pWatched = rep;
    _watched = row.attr;
    _events.clear();
    (_adapter.*row.set)(7, 1);
    EXPECT_EQ(Stored(rep, row.attr), Values{1});
    ASSERT_EQ(_events.size(), 1u);
    EXPECT_EQ(_events[0].name, row.event());
    EXPECT_EQ(_events[0].data, static_cast<void*>(&_adapter));
    EXPECT_EQ(_events[0].notif, nullptr);
    EXPECT_EQ(_events[0].storedAtDispatch, Values{1}); // written before the event
    (_adapter.*row.set)(0, 0);
    EXPECT_EQ((_adapter.*row.get)(), 0);
    EXPECT_EQ(_events.size(), 1u);
    // A refused write is reported and never notified.
    rep->SetLock(row.attr, true);
    ZEPCheckLog::Clear();
    (_adapter.*row.set)(1, 1);
    EXPECT_EQ(ZEPCheckLog::Count(), 1);
    EXPECT_EQ(_events.size(), 1u);
    rep->SetLock(row.attr, false);
  }
  EXPECT_TRUE(ZEPCheckLog::Contains("1==_pSettRep->WriteAttr(mstrShowPosition, &val)"));
  for (auto [given, written] : std::initializer_list<std::pair<int, int>>{{3, 1}, {-1, 1}, {2, 2}, {0, 0}}) {
    _adapter.SetDragMode(given, 0);
    EXPECT_EQ(Stored(_pGeneral, "Drw_settings_DragModeR14"), Values{double(written)}) << given;
  }
  _adapter.SetValidateConstraint(9, 1);
  EXPECT_EQ(Stored(_pGeneral, "CstCreation"), Values{1});
  EXPECT_EQ(_events.back().name, Adapt::CpltModification());
}

// One per-range setting: defaults without and with an empty repository, then writes from
// an empty attribute (the other ranges get their defaults), normalised, notified after the write.
template <class T>
void CheckRange(SketcherAdapter& t, const char* iAttr, Values iDefaults, T (Adapt::*iGet)(ZEPCkeScale),
                void (Adapt::*iSet)(T, int, ZEPCkeScale), T iBad, T iBadWritten, T iGood, T iGoodWritten) {
  SCOPED_TRACE(iAttr);
  for (bool connected : {false, true}) {
    t._adapter.UseRepositories(connected ? t._pGeneral : nullptr, connected ? t._pSpecific : nullptr);
    for (int range = 0; range <= 6; ++range) {
      // Without a repository, and outside 1 to 5, the answer is that of range 1.
      const bool own = connected && range >= 1 && range <= 5;
      EXPECT_DOUBLE_EQ((t._adapter.*iGet)(Range(range)), iDefaults[own ? range - 1 : 0]) << range;
    }
  }
  Values expected = iDefaults;
  expected[2] = iGoodWritten;
  t._pWatched = t._pSpecific;
  t._watched = iAttr;
  t._events.clear();
  (t._adapter.*iSet)(iGood, 1, Range(3));
  EXPECT_EQ(Stored(t._pSpecific, iAttr), expected);
  ASSERT_EQ(t._events.size(), 1u);
  EXPECT_EQ(t._events[0].name, Adapt::GridModification());
  EXPECT_EQ(t._events[0].storedAtDispatch, expected);
  // Ranges 0 and 6 write the entry that range 1 is read from.
  for (int range : {0, 6, 5}) {
    (t._adapter.*iSet)(iBad, 0, Range(range));
    expected[range == 5 ? 4 : 0] = iBadWritten;
    EXPECT_EQ(Stored(t._pSpecific, iAttr), expected) << range;
  }
  EXPECT_EQ(t._events.size(), 1u);
}

TEST_F(SketcherAdapter, RangeSettersWriteTheirRangeAndKeepTheOthers) {
  const Values spacing = {100.0, 10000.0, 1000000.0, 1.0, 0.01}, steps(5, 10.0), flags(5, 0.0);
  CheckRange(*this, "Drw_settings_GridPrimarySpacing", spacing, &Adapt::GetGridPrimSpac, &Adapt::SetGridPrimSpac, -5.0,
             100.0, 2.5, 2.5);
  CheckRange(*this, "Drw_settings_GridSecondaryStep", steps, &Adapt::GetGridSecStep, &Adapt::SetGridSecStep, 0, 10, 4,
             4);
  CheckRange(*this, "Drw_settings_AllowDistortions", flags, &Adapt::GetAllowDistortions, &Adapt::SetAllowDistortions, 0,
             0, 5, 1);
  CheckRange(*this, "Drw_settings_GridVPrimarySpacing", spacing, &Adapt::GetGridVPrimSpac, &Adapt::SetGridVPrimSpac,
             0.0, 100.0, 7.0, 7.0);
  CheckRange(*this, "Drw_settings_GridVSecondaryStep", steps, &Adapt::GetGridVSecStep, &Adapt::SetGridVSecStep, -3, 10,
             2, 2);

  _pSpecific->SetUserValue("Drw_settings_GridPrimarySpacing", Values{1, 2, 3, 4, 5});
  _adapter.SetGridPrimSpac(42.0, 0, Range(4));
  EXPECT_EQ(Stored(_pSpecific, "Drw_settings_GridPrimarySpacing"), (Values{1, 2, 3, 42, 5}));
  _pSpecific->SetLock("Drw_settings_GridPrimarySpacing", true);
  _events.clear();
  _adapter.SetGridPrimSpac(8.0, 1, Range(1));
  EXPECT_TRUE(ZEPCheckLog::Contains("1==_pSpecificSettRep->WriteAttr(mstrGridHPrSpacing, &gridSpacingH)"));
  EXPECT_TRUE(_events.empty());
}

TEST_F(SketcherAdapter, ConstraintCreationAndTypes) {
  Connect();
  _pGeneral->SetUserValue("CstCreation", std::vector<int>{1});
  for (const char* attr : {"Drw_settings_CpltPosSupport", "Drw_settings_CpltPosHorVertTo",
                           "Drw_settings_CpltDirHorVert", "Drw_settings_CpltDirParPerpTan"})
    _pGeneral->SetUserValue(attr, std::vector<int>{0});
  EXPECT_EQ(_adapter.GetCreateConstraint(), 0);
  EXPECT_EQ(_adapter.GetValidateConstraint(), 0);
  _pGeneral->SetUserValue("Drw_settings_CpltDirHorVert", std::vector<int>{1});
  EXPECT_EQ(_adapter.GetCreateConstraint(), 1);

  for (int type : {1, 2, 4, 10}) EXPECT_EQ(_adapter.GetValidateCstType(static_cast<ZEP2DCstType>(type)), 0) << type;
  for (int type : {0, 3, 5, 6, 7, 8, 9, 11, -1})
    EXPECT_EQ(_adapter.GetValidateCstType(static_cast<ZEP2DCstType>(type)), 1) << type;
}

TEST_F(SketcherAdapter, Colours) {
  Connect();
  Rgb c = {77, 77, 77};
  _adapter.GetColorConstructElts(nullptr, &c[1], &c[2]);
  _adapter.GetColorSmartPick(&c[0], nullptr, &c[2]);
  _adapter.GetColorDiagElts(ZEP2DCstOverDefined, &c[0], &c[1], nullptr);
  EXPECT_EQ(ZEPCheckLog::Count(), 3);
  EXPECT_TRUE(ZEPCheckLog::Contains("iRed && iGreen && iBlue"));
  EXPECT_EQ(c, (Rgb{77, 77, 77}));

  _adapter.SetColorDiagElts(ZEP2DCstNotChanged, 1, 2, 3, 0);
  _adapter.GetColorDiagElts(ZEP2DCstNotChanged, &c[0], &c[1], &c[2]);
  EXPECT_EQ(c, (Rgb{1, 2, 3}));
  // An incomplete stored colour is reported and gives the default.
  _pSpecific->SetUserValue("Drw_settings_DiagNotConsistentEltsColor", std::vector<unsigned int>{9, 9});
  _adapter.GetColorDiagElts(ZEP2DCstNotConsistent, &c[0], &c[1], &c[2]);
  EXPECT_EQ(c, (Rgb{255, 0, 0}));

  _pSpecific->SetLock("Drw_settings_DiagWellDefinedEltsColor", true);
  _adapter.SetColorDiagElts(ZEP2DCstWellDefined, 1, 1, 1, 1);
  EXPECT_TRUE(ZEPCheckLog::Contains("1 ==_pSpecificSettRep->WriteAttr(pName, tab, 3)"));
  EXPECT_TRUE(_events.empty());

  // A diagnosis without a setting: the subclass default, nothing read or written, still notified.
  _adapter.UseRepositories(nullptr, nullptr);
  ZEPCheckLog::Clear();
  _adapter._uDefaultDiag = 0xA1B2C3;
  _adapter.GetColorDiagElts(static_cast<ZEP2DCstDiag>(5), &c[0], &c[1], &c[2]);
  EXPECT_EQ(c, (Rgb{0xA1, 0xB2, 0xC3}));
  _adapter.SetColorDiagElts(static_cast<ZEP2DCstDiag>(5), 1, 2, 3, 1);
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ASSERT_EQ(_events.size(), 1u);
  EXPECT_EQ(_events[0].name, Adapt::GeomUIModification());
}

TEST_F(SketcherAdapter, SaveRepository) {
  EXPECT_EQ(_adapter.SaveRepository(), E_FAIL);
  EXPECT_TRUE(ZEPCheckLog::Contains("_pSettRep"));
  _adapter.UseRepositories(_pGeneral, nullptr);
  EXPECT_EQ(_adapter.SaveRepository(), E_FAIL);
  EXPECT_TRUE(ZEPCheckLog::Contains("_pSpecificSettRep"));

  Connect();
  int specificSaves = 0;
  long generalStatus = E_FAIL;
  _pGeneral->SetSaveHandler([&](ZEPSysSettingRepository&) { return generalStatus; });
  _pSpecific->SetSaveHandler([&](ZEPSysSettingRepository&) { return ++specificSaves, S_OK; });
  _adapter.SetCreateCenter(0, 0);
  _adapter.SetGridVisuMode(0, 0);
  EXPECT_EQ(_adapter.SaveRepository(), E_FAIL);
  EXPECT_TRUE(ZEPCheckLog::Contains("SUCCEEDED(_pSettRep->SaveRepository())"));
  EXPECT_EQ(specificSaves, 0);

  generalStatus = S_OK;
  EXPECT_EQ(_adapter.SaveRepository(), S_OK);
  EXPECT_EQ(specificSaves, 1);
}
