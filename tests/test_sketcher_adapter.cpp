// Sketcher settings adapter: defaults, normalisation, per-range writes, notifications, failures.
#include "TestSupport.h"

#include "ZEP2DBaseSketcherSettingsAdapt.h"

#include <functional>
#include <variant>

namespace {
using Adapt = ZEP2DBaseSketcherSettingsAdapt;

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
std::vector<double> Stored(const ZEPSysSettingRepository* iRep, const std::string& iName) {
  std::vector<double> out;
  if (const auto* v = iRep->Effective(iName))
    std::visit([&](const auto& vec) { out.assign(vec.begin(), vec.end()); }, *v);
  return out;
}

struct Event {
  std::string name;
  void* data;
  ZEPNotification* notif;
  std::vector<double> storedAtDispatch;
};

class SketcherAdapter : public ZEPHostTest {
protected:
  void SetUp() override {
    ZEPHostTest::SetUp();
    _pGeneral = ZEPSysSettingRepository::Open("SketcherGeneral");
    _pSpecific = ZEPSysSettingRepository::Open("SketcherSpecific");
    for (const char* name : {Adapt::MultiModification(), Adapt::GridModification(), Adapt::GeomUIModification(),
                             Adapt::SnapModification(), Adapt::Visu3DUIModification(), Adapt::CpltModification()})
      _adapter.AddCallback(name, [this](const char* iName, ZEPNotification* iNotif, void* iData) {
        _events.push_back({iName, iData, iNotif, _pWatched ? Stored(_pWatched, _watchedName) : std::vector<double>{}});
      });
  }
  void Connect() { _adapter.UseRepositories(_pGeneral, _pSpecific); }
  void Watch(const ZEPSysSettingRepository* iRep, const std::string& iName) {
    _pWatched = iRep;
    _watchedName = iName;
  }

  TestAdapter _adapter;
  ZEPSysSettingRepository* _pGeneral = nullptr;
  ZEPSysSettingRepository* _pSpecific = nullptr;
  std::vector<Event> _events;
  const ZEPSysSettingRepository* _pWatched = nullptr;
  std::string _watchedName;
};

struct ScalarRow {
  const char* attr;
  bool specific;
  int readDefault;
  int (Adapt::*get)();
  void (Adapt::*set)(int, int);
  const char* (*event)();
};

// Every int setting with its attribute, repository, default and event; the forwarding
// operations appear with the attribute they end up in.
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

struct RangeRow {
  const char* attr;
  std::vector<double> defaults;
  double noRepository;
  std::function<double(Adapt&, int)> get;
  std::function<void(Adapt&, double, int, int)> set;
  double bad, badWritten, good, goodWritten;
};

ZEPCkeScale Range(int iRange) { return static_cast<ZEPCkeScale>(iRange); }

const std::vector<RangeRow>& RangeRows() {
  static const std::vector<double> spacing = {100.0, 10000.0, 1000000.0, 1.0, 0.01};
  static const std::vector<RangeRow> rows = {
      {"Drw_settings_GridPrimarySpacing", spacing, 100.0,
       [](Adapt& a, int r) { return a.GetGridPrimSpac(Range(r)); },
       [](Adapt& a, double v, int n, int r) { a.SetGridPrimSpac(v, n, Range(r)); }, -5.0, 100.0, 2.5, 2.5},
      {"Drw_settings_GridSecondaryStep", {10, 10, 10, 10, 10}, 10,
       [](Adapt& a, int r) { return a.GetGridSecStep(Range(r)); },
       [](Adapt& a, double v, int n, int r) { a.SetGridSecStep(static_cast<int>(v), n, Range(r)); }, 0, 10, 4, 4},
      {"Drw_settings_AllowDistortions", {0, 0, 0, 0, 0}, 0,
       [](Adapt& a, int r) { return a.GetAllowDistortions(Range(r)); },
       [](Adapt& a, double v, int n, int r) { a.SetAllowDistortions(static_cast<int>(v), n, Range(r)); }, 0, 0, 5, 1},
      {"Drw_settings_GridVPrimarySpacing", spacing, 100.0,
       [](Adapt& a, int r) { return a.GetGridVPrimSpac(Range(r)); },
       [](Adapt& a, double v, int n, int r) { a.SetGridVPrimSpac(v, n, Range(r)); }, 0.0, 100.0, 7.0, 7.0},
      {"Drw_settings_GridVSecondaryStep", {10, 10, 10, 10, 10}, 10,
       [](Adapt& a, int r) { return a.GetGridVSecStep(Range(r)); },
       [](Adapt& a, double v, int n, int r) { a.SetGridVSecStep(static_cast<int>(v), n, Range(r)); }, -3, 10, 2, 2},
  };
  return rows;
}
} // namespace

TEST_F(SketcherAdapter, DefaultsWithoutAndWithEmptyRepositories) {
  for (bool connected : {false, true}) {
    SCOPED_TRACE(connected ? "empty repositories" : "no repositories");
    if (connected) Connect();
    for (const ScalarRow& row : kScalars) {
      SCOPED_TRACE(row.attr);
      ZEPCheckLog::Clear();
      EXPECT_EQ((_adapter.*row.get)(), row.readDefault);
      EXPECT_EQ(ZEPCheckLog::Count(), 1); // the missing repository, or the failed read
      if (!connected) {
        EXPECT_TRUE(ZEPCheckLog::Contains(row.specific ? "_pSpecificSettRep" : "_pSettRep"));
      }
    }
    for (const RangeRow& row : RangeRows())
      for (int range = 0; range <= 6; ++range) {
        const double expected =
            !connected ? row.noRepository : row.defaults[static_cast<size_t>(range >= 1 && range <= 5 ? range - 1 : 0)];
        EXPECT_DOUBLE_EQ(row.get(_adapter, range), expected) << row.attr << " range " << range;
      }
    unsigned int r = 0, g = 0, b = 0;
    _adapter.GetColorSmartPick(&r, &g, &b);
    EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>({67, 102, 85}));
    _adapter.GetColorConstructElts(&r, &g, &b);
    EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>({140, 140, 140}));
    // The table's diagnosis colours win over the subclass default for the four known kinds.
    const unsigned int diag[4][3] = {{255, 0, 255}, {255, 0, 0}, {128, 0, 0}, {0, 255, 0}};
    for (int d = 1; d <= 4; ++d) {
      _adapter.GetColorDiagElts(static_cast<ZEP2DCstDiag>(d), &r, &g, &b);
      EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>(diag[d - 1], diag[d - 1] + 3)) << d;
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
    Watch(rep, row.attr);
    _events.clear();
    (_adapter.*row.set)(7, 1);
    EXPECT_EQ(Stored(rep, row.attr), std::vector<double>{1});
    ASSERT_EQ(_events.size(), 1u);
    EXPECT_EQ(_events[0].name, row.event());
    EXPECT_EQ(_events[0].data, static_cast<void*>(&_adapter));
    EXPECT_EQ(_events[0].notif, nullptr);
    EXPECT_EQ(_events[0].storedAtDispatch, std::vector<double>{1}); // written before the event
    (_adapter.*row.set)(0, 0);
    EXPECT_EQ(Stored(rep, row.attr), std::vector<double>{0});
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
    EXPECT_EQ(Stored(_pGeneral, "Drw_settings_DragModeR14"), std::vector<double>{double(written)}) << given;
  }
  _adapter.SetValidateConstraint(9, 1);
  EXPECT_EQ(Stored(_pGeneral, "CstCreation"), std::vector<double>{1});
  EXPECT_EQ(_events.back().name, Adapt::CpltModification());
}

TEST_F(SketcherAdapter, RangeSettersWriteTheirRangeAndKeepTheOthers) {
  Connect();
  for (const RangeRow& row : RangeRows()) {
    SCOPED_TRACE(row.attr);
    // From an empty attribute: the other ranges are written with their defaults.
    std::vector<double> expected = row.defaults;
    Watch(_pSpecific, row.attr);
    _events.clear();
    row.set(_adapter, row.good, 1, 3);
    expected[2] = row.goodWritten;
    EXPECT_EQ(Stored(_pSpecific, row.attr), expected);
    ASSERT_EQ(_events.size(), 1u);
    EXPECT_EQ(_events[0].name, Adapt::GridModification());
    EXPECT_EQ(_events[0].storedAtDispatch, expected);
    EXPECT_DOUBLE_EQ(row.get(_adapter, 3), row.goodWritten);
    // Normalised value; ranges 0 and 6 write the entry range 1 is read from.
    for (int range : {0, 6, 5}) {
      row.set(_adapter, row.bad, 0, range);
      expected[static_cast<size_t>(range == 5 ? 4 : 0)] = row.badWritten;
      EXPECT_EQ(Stored(_pSpecific, row.attr), expected) << range;
    }
    EXPECT_EQ(_events.size(), 1u);
  }
  // Values already stored for the other ranges stay.
  _pSpecific->SetUserValue("Drw_settings_GridPrimarySpacing", std::vector<double>{1, 2, 3, 4, 5});
  _adapter.SetGridPrimSpac(42.0, 0, Range(4));
  EXPECT_EQ(Stored(_pSpecific, "Drw_settings_GridPrimarySpacing"), std::vector<double>({1, 2, 3, 42, 5}));
  EXPECT_DOUBLE_EQ(_adapter.GetGridPrimSpac(Range(2)), 2.0);

  _pSpecific->SetLock("Drw_settings_GridPrimarySpacing", true);
  _events.clear();
  ZEPCheckLog::Clear();
  _adapter.SetGridPrimSpac(8.0, 1, Range(1));
  EXPECT_TRUE(ZEPCheckLog::Contains("1==_pSpecificSettRep->WriteAttr(mstrGridHPrSpacing, &gridSpacingH)"));
  EXPECT_EQ(_events.size(), 0u);
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
  _pGeneral->SetUserValue("CstCreation", std::vector<double>{1.0}); // wrong type: unreadable
  ZEPCheckLog::Clear();
  EXPECT_EQ(_adapter.GetValidateConstraint(), 0);
  EXPECT_TRUE(ZEPCheckLog::Contains("1==_pSettRep->ReadAttr(\"CstCreation\", &val)"));

  for (int type : {1, 2, 4, 10}) EXPECT_EQ(_adapter.GetValidateCstType(static_cast<ZEP2DCstType>(type)), 0) << type;
  for (int type : {0, 3, 5, 6, 7, 8, 9, 11, -1})
    EXPECT_EQ(_adapter.GetValidateCstType(static_cast<ZEP2DCstType>(type)), 1) << type;
}

TEST_F(SketcherAdapter, Colours) {
  // Null outputs: reported, nothing written.
  Connect();
  unsigned int g = 77, b = 77;
  _adapter.GetColorConstructElts(nullptr, &g, &b);
  _adapter.GetColorSmartPick(&g, nullptr, &b);
  _adapter.GetColorDiagElts(ZEP2DCstOverDefined, &g, &b, nullptr);
  EXPECT_EQ(ZEPCheckLog::Count(), 3);
  EXPECT_TRUE(ZEPCheckLog::Contains("iRed && iGreen && iBlue"));
  EXPECT_EQ(g, 77u);
  EXPECT_EQ(b, 77u);

  // Stored colours come back; an incomplete one is reported and gives the default.
  unsigned int r = 0;
  _adapter.SetColorDiagElts(ZEP2DCstNotChanged, 1, 2, 3, 0);
  _adapter.GetColorDiagElts(ZEP2DCstNotChanged, &r, &g, &b);
  EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>({1, 2, 3}));
  _adapter.SetColorSmartPick(4, 5, 6, 0);
  _adapter.GetColorSmartPick(&r, &g, &b);
  EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>({4, 5, 6}));
  _pSpecific->SetUserValue("Drw_settings_DiagNotConsistentEltsColor", std::vector<unsigned int>{9, 9});
  ZEPCheckLog::Clear();
  _adapter.GetColorDiagElts(ZEP2DCstNotConsistent, &r, &g, &b);
  EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>({255, 0, 0}));
  EXPECT_TRUE(ZEPCheckLog::Contains("3==_pSpecificSettRep->ReadAttr(pName, tab, 3)"));

  _pSpecific->SetLock("Drw_settings_DiagWellDefinedEltsColor", true);
  _events.clear();
  _adapter.SetColorDiagElts(ZEP2DCstWellDefined, 1, 1, 1, 1);
  EXPECT_TRUE(ZEPCheckLog::Contains("1 ==_pSpecificSettRep->WriteAttr(pName, tab, 3)"));
  EXPECT_EQ(_events.size(), 0u);

  // A diagnosis without a setting: the subclass default, nothing read or written, still notified.
  _adapter.UseRepositories(nullptr, nullptr);
  ZEPCheckLog::Clear();
  _adapter._uDefaultDiag = 0xA1B2C3;
  _adapter.GetColorDiagElts(static_cast<ZEP2DCstDiag>(5), &r, &g, &b);
  EXPECT_EQ(std::vector<unsigned int>({r, g, b}), std::vector<unsigned int>({0xA1, 0xB2, 0xC3}));
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
  int generalSaves = 0, specificSaves = 0;
  long generalStatus = E_FAIL, specificStatus = S_OK;
  _pGeneral->SetSaveHandler([&](ZEPSysSettingRepository&) { ++generalSaves; return generalStatus; });
  _pSpecific->SetSaveHandler([&](ZEPSysSettingRepository&) { ++specificSaves; return specificStatus; });
  _adapter.SetCreateCenter(0, 0);
  _adapter.SetGridVisuMode(0, 0);
  ZEPCheckLog::Clear();
  EXPECT_EQ(_adapter.SaveRepository(), E_FAIL);
  EXPECT_TRUE(ZEPCheckLog::Contains("SUCCEEDED(_pSettRep->SaveRepository())"));
  EXPECT_EQ(generalSaves, 1);
  EXPECT_EQ(specificSaves, 0);

  generalStatus = S_OK;
  specificStatus = E_FAIL;
  EXPECT_EQ(_adapter.SaveRepository(), E_FAIL);
  EXPECT_TRUE(ZEPCheckLog::Contains("SUCCEEDED(_pSpecificSettRep->SaveRepository())"));
  specificStatus = S_OK;
  EXPECT_EQ(_adapter.SaveRepository(), S_OK);
  EXPECT_FALSE(_pGeneral->IsModified());
  EXPECT_FALSE(_pSpecific->IsModified());
  EXPECT_EQ(specificSaves, 2);
}

TEST_F(SketcherAdapter, UnsubscribedCallbacksAreNotCalled) {
  int calls = 0;
  ZEPCallbackManager::CallbackId id = 0;
  id = _adapter.AddCallback(Adapt::GridModification(), [&](const char*, ZEPNotification*, void*) {
    ++calls;
    _adapter.RemoveCallback(id); // removing itself during the dispatch
  });
  _adapter.GridModify();
  _adapter.GridModify();
  EXPECT_EQ(calls, 1);
  EXPECT_FALSE(_adapter.RemoveCallback(id));
}
