// The camera's record: what a new camera holds, the keys written in order, the read with its
// defaults and required keys, copies, deletion, and cameras kept through a saved drawing file.
#include <string>
#include <vector>

#include "model/status_codes.h"
#include "tests/views/views_fixture.h"

namespace {

const std::vector<std::string> kCameraKeys = {
    "@EYE=",     "@TARGET=",   "@CONE=",     "@VIEWMODE=",      "@LYRCFG=", "@CAMNAME=",   "@DSP=",    "@CONF=",
    "@S2D=",     "@2DFILE=",   "@COMMENT=",  "@PATTERN=",       "@SHOWSEC=", "@AUTOCLIP=", "@S2DOVERWRITE=",
    "@CLINE=",   "@LINEMERGE=", "@SCALE=",   "@PRESDIM=",       "@PRESLYR=", "@PRESLYRN=", "@PRESTXT=", "@PRESWLS="};

// The writes one SaveTo makes: everything from the first key on.
std::vector<std::string> FromFirstKey(const std::vector<std::string>& writes) {
  for (auto it = writes.begin(); it != writes.end(); ++it) {
    if (*it == "@EYE=") return {it, writes.end()};
  }
  return {};
}

class CameraRecordTest : public ViewsTest {};

TEST_F(CameraRecordTest, NewCameraHoldsTheResetValues) {
  HRCamera camera;
  EXPECT_EQ(camera.GetName(), "Camera");
  EXPECT_EQ(camera.GetClassName(), "HRCamera");
  EXPECT_EQ(camera.IsFor2D(), 0);
  EXPECT_FALSE(camera.HasPatterns());
  EXPECT_EQ(camera.GetHandle(), 0);
  const CameraSettings settings = SettingsOf(camera);
  EXPECT_EQ(settings.viewMode, HRCamera::k2DParallel);
  EXPECT_EQ(settings.displayMode, 0);
  EXPECT_EQ(settings.layers, HRCamera::LayerTable{});
  EXPECT_EQ(settings.scaleMode, 'a');
  EXPECT_EQ(settings.showSections, 1);
  EXPECT_EQ(settings.autoClip, 1);
  EXPECT_EQ(settings.overwrite2D, 1);
  EXPECT_EQ(settings.removeCoincident, 1);
  EXPECT_EQ(settings.lineMerge, 1);
  EXPECT_EQ(settings.preserveDimensions + settings.preserveText + settings.preserveWalls + settings.preserveLayer, 0);
  EXPECT_EQ(settings.preserveLayerIndex, 1);
  EXPECT_EQ(settings.file2D, "");
  EXPECT_EQ(settings.comment, "");
}

TEST_F(CameraRecordTest, ResetRestoresDefaultsButKeepsTheView) {
  HRCamera camera;
  camera.SetSettings(DistinctSettings());
  camera.SetName("Kitchen");
  camera.SetFor2D(1);
  camera.Reset();
  const CameraSettings settings = SettingsOf(camera);
  EXPECT_EQ(camera.GetName(), "Camera");
  EXPECT_EQ(camera.IsFor2D(), 0);
  EXPECT_EQ(settings.patterns, 0);
  EXPECT_EQ(settings.autoClip, 1);
  EXPECT_EQ(settings.preserveLayerIndex, 1);
  EXPECT_EQ(settings.layers, HRCamera::LayerTable{});
  // Eye, target, cone and window are always captured or loaded before use; reset leaves them.
  EXPECT_EQ(settings.eye[0], DistinctSettings().eye[0]);
  EXPECT_EQ(settings.cone, DistinctSettings().cone);
  EXPECT_DOUBLE_EQ(settings.viewWindow[2], DistinctSettings().viewWindow[2]);
}

TEST_F(CameraRecordTest, CreateWritesEveryKeyInOrderAndTheClassLast) {
  HRCamera camera;
  camera.SetSettings(DistinctSettings());
  camera.SetName("Entrance");
  camera.SetFor2D(1);
  ASSERT_EQ(camera.Create(), 0);
  const host::EntityHandle entity = camera.GetHandle();
  ASSERT_NE(entity, 0);
  EXPECT_EQ(Find(entity)->Type(), host::kTypeGroup);

  std::vector<std::string> expected = kCameraKeys;
  expected.push_back("@Class=");
  EXPECT_EQ(FromFirstKey(WritesTo(entity)), expected);

  EXPECT_EQ(AttributeOf(entity, "@Class=")->text, "HRCamera");
  EXPECT_EQ(AttributeOf(entity, "@CAMNAME=")->text, "Entrance");
  EXPECT_EQ(AttributeOf(entity, "@EYE=")->floats, (std::vector<float>{10.5F, -20.25F, 1.75F}));
  EXPECT_EQ(AttributeOf(entity, "@EYE=")->format, 6);
  EXPECT_EQ(AttributeOf(entity, "@TARGET=")->format, 6);
  EXPECT_EQ(AttributeOf(entity, "@CONE=")->format, 6);
  EXPECT_EQ(AttributeOf(entity, "@CONE=")->floatValue, 37.5F);
  EXPECT_EQ(AttributeOf(entity, "@CONF=")->text, "-12.125000 -7.500000 30.000000 19.875000");
  EXPECT_EQ(AttributeOf(entity, "@LYRCFG=")->shorts.size(), 256U);
  EXPECT_EQ(AttributeOf(entity, "@LYRCFG=")->shorts[3], 1);
  EXPECT_EQ(AttributeOf(entity, "@LYRCFG=")->shorts[4], 0);
  EXPECT_EQ(AttributeOf(entity, "@VIEWMODE=")->shortValue, 3);
  EXPECT_EQ(AttributeOf(entity, "@DSP=")->shortValue, 4);
  EXPECT_EQ(AttributeOf(entity, "@S2D=")->shortValue, 1);
  EXPECT_EQ(AttributeOf(entity, "@SCALE=")->shortValue, 'f');
  EXPECT_EQ(AttributeOf(entity, "@PRESLYRN=")->shortValue, 17);
  EXPECT_EQ(AttributeOf(entity, "@2DFILE=")->text, "plans\\ground floor.dxf");
}

TEST_F(CameraRecordTest, SavedCameraLoadsBackWithEveryValue) {
  HRCamera camera;
  camera.SetSettings(DistinctSettings());
  camera.SetName("Stair hall");
  camera.SetFor2D(1);
  ASSERT_EQ(camera.Create(), 0);

  HRCamera loaded;
  ASSERT_EQ(loaded.Load(camera.GetHandle()), 0);
  ExpectSameSettings(SettingsOf(loaded), DistinctSettings());
  EXPECT_EQ(loaded.GetName(), "Stair hall");
  EXPECT_EQ(loaded.IsFor2D(), 1);
  EXPECT_TRUE(loaded.IsCamera());
  EXPECT_TRUE(loaded.HasPatterns());
  EXPECT_EQ(loaded.GetHandle(), camera.GetHandle());
}

TEST_F(CameraRecordTest, BooleansAreWrittenAsZeroOrOneAndReadBackAsOne) {
  CameraSettings settings = DistinctSettings();
  settings.patterns = 5;
  settings.showSections = 9;
  settings.autoClip = 2;
  settings.preserveWalls = 200;
  HRCamera camera;
  camera.SetSettings(settings);
  ASSERT_EQ(camera.Create(), 0);
  const host::EntityHandle entity = camera.GetHandle();
  EXPECT_EQ(AttributeOf(entity, "@PATTERN=")->shortValue, 1);
  EXPECT_EQ(AttributeOf(entity, "@SHOWSEC=")->shortValue, 1);
  EXPECT_EQ(AttributeOf(entity, "@AUTOCLIP=")->shortValue, 1);
  EXPECT_EQ(AttributeOf(entity, "@PRESWLS=")->shortValue, 1);

  // A record written elsewhere may hold any non-zero value for "on".
  for (const char* key : {"@PATTERN=", "@SHOWSEC=", "@AUTOCLIP=", "@S2DOVERWRITE=", "@CLINE=", "@LINEMERGE=",
                          "@PRESDIM=", "@PRESTXT=", "@PRESLYR=", "@PRESWLS="}) {
    PutShort(entity, key, 5);
  }
  HRCamera loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  const CameraSettings read = SettingsOf(loaded);
  for (const std::uint8_t flag : {read.patterns, read.showSections, read.autoClip, read.overwrite2D,
                                  read.removeCoincident, read.lineMerge, read.preserveDimensions, read.preserveText,
                                  read.preserveLayer, read.preserveWalls}) {
    EXPECT_EQ(flag, 1);
  }
}

TEST_F(CameraRecordTest, ScaleModeCharactersSurviveTheRecord) {
  for (const char mode : {'a', 'f', 'o', ' '}) {
    CameraSettings settings = DistinctSettings();
    settings.scaleMode = mode;
    HRCamera camera;
    camera.SetSettings(settings);
    ASSERT_EQ(camera.Create(), 0);
    EXPECT_EQ(AttributeOf(camera.GetHandle(), "@SCALE=")->shortValue, static_cast<std::int16_t>(mode));
    HRCamera loaded;
    ASSERT_EQ(loaded.Load(camera.GetHandle()), 0);
    EXPECT_EQ(SettingsOf(loaded).scaleMode, mode) << "mode '" << mode << "'";
  }
}

TEST_F(CameraRecordTest, RecordWithoutDefaultedKeysLoadsWithTheirDefaults) {
  const host::EntityHandle entity = StoreCamera("Old record");
  for (const char* key : {"@2DFILE=", "@COMMENT=", "@AUTOCLIP=", "@S2DOVERWRITE=", "@CLINE=", "@LINEMERGE=",
                          "@SCALE=", "@PRESDIM=", "@PRESTXT=", "@PRESLYR=", "@PRESLYRN=", "@PRESWLS="}) {
    DropAttribute(entity, key);
  }
  HRCamera loaded;
  loaded.Set2DFile("left over");
  ASSERT_EQ(loaded.Load(entity), 0);
  const CameraSettings settings = SettingsOf(loaded);
  EXPECT_EQ(settings.file2D, "");
  EXPECT_EQ(settings.comment, "");
  EXPECT_EQ(settings.autoClip, 1);
  EXPECT_EQ(settings.overwrite2D, 1);
  EXPECT_EQ(settings.removeCoincident, 1);
  EXPECT_EQ(settings.lineMerge, 1);
  EXPECT_EQ(settings.scaleMode, 'a');
  EXPECT_EQ(settings.preserveDimensions, 0);
  EXPECT_EQ(settings.preserveText, 0);
  EXPECT_EQ(settings.preserveLayer, 0);
  EXPECT_EQ(settings.preserveWalls, 0);
  // An old record counts from layer index 0, unlike a freshly reset camera.
  EXPECT_EQ(settings.preserveLayerIndex, 0);
  EXPECT_EQ(loaded.GetName(), "Old record");
  EXPECT_EQ(settings.patterns, 1);
}

class CameraRequiredKeyTest : public ViewsTest, public ::testing::WithParamInterface<const char*> {};

TEST_P(CameraRequiredKeyTest, RecordWithoutItDoesNotLoad) {
  const host::EntityHandle entity = StoreCamera("Incomplete");
  DropAttribute(entity, GetParam());
  HRCamera loaded;
  EXPECT_EQ(loaded.Load(entity), model_status::kAttributeFailed);
  SetDatabase(Bench().Current());
  EXPECT_EQ(GetGeneralCameraCount(), 0);
}

INSTANTIATE_TEST_SUITE_P(EveryRequiredKey, CameraRequiredKeyTest,
                         ::testing::Values("@EYE=", "@TARGET=", "@CONE=", "@VIEWMODE=", "@LYRCFG=", "@CAMNAME=",
                                           "@Class=", "@CONF=", "@DSP=", "@S2D=", "@PATTERN=", "@SHOWSEC="));

TEST_F(CameraRecordTest, DamagedRecordsAreRefusedWithoutReadingPastThem) {
  const host::EntityHandle entity = StoreCamera("Damaged");
  // A layer table cut short must not be read beyond its end.
  Find(entity)->FindAttribute("@LYRCFG=")->shorts.resize(10);
  HRCamera shortLayers;
  EXPECT_EQ(shortLayers.Load(entity), model_status::kAttributeFailed);

  const host::EntityHandle other = StoreCamera("Wrong type");
  PutString(other, "@DSP=", "4");
  HRCamera wrongType;
  EXPECT_EQ(wrongType.Load(other), model_status::kAttributeFailed);

  // A defaulted key that is present but unreadable is a failure, not a default.
  const host::EntityHandle third = StoreCamera("Refused read");
  FailOn("qel_read_short_attribute", "@AUTOCLIP=");
  HRCamera refused;
  EXPECT_EQ(refused.Load(third), model_status::kAttributeFailed);
}

TEST_F(CameraRecordTest, ViewWindowTextWithFewerNumbersStillLoads) {
  const host::EntityHandle entity = StoreCamera("Short window");
  PutString(entity, "@CONF=", "1.5 2.5");
  HRCamera loaded;
  ASSERT_EQ(loaded.Load(entity), 0);
  const CameraSettings settings = SettingsOf(loaded);
  EXPECT_DOUBLE_EQ(settings.viewWindow[0], 1.5);
  EXPECT_DOUBLE_EQ(settings.viewWindow[1], 2.5);
}

TEST_F(CameraRecordTest, LoadPassesGroupAndRecordFailuresOn) {
  HRCamera camera;
  EXPECT_EQ(camera.Load(4711), model_status::kHeaderNotRead);
  const host::EntityHandle line = Drawing().Add(host::kTypeLine).handle;
  EXPECT_EQ(camera.Load(line), model_status::kWrongEntity);

  const host::EntityHandle entity = StoreCamera("Closed");
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(camera.Load(entity), model_status::kRecordNotOpened);
}

TEST_F(CameraRecordTest, SaveStopsAtTheFirstRefusedWriteAndLeavesTheClassAlone) {
  const host::EntityHandle entity = StoreCamera("Partial");
  HRCamera camera;
  ASSERT_EQ(camera.Load(entity), 0);
  camera.SetName("Renamed");
  DropAttribute(entity, "@Class=");
  ClearJournal();
  FailOn("qel_set_short_attribute", "@DSP=");

  EXPECT_EQ(camera.Save(), model_status::kStringNotWritten);
  EXPECT_EQ(WritesTo(entity),
            (std::vector<std::string>{"@EYE=", "@TARGET=", "@CONE=", "@VIEWMODE=", "@LYRCFG=", "@CAMNAME="}));
  EXPECT_EQ(AttributeOf(entity, "@Class="), nullptr);
  EXPECT_EQ(AttributeOf(entity, "@CAMNAME=")->text, "Renamed");
}

TEST_F(CameraRecordTest, RefusedClassMarkerFailsTheSave) {
  const host::EntityHandle entity = StoreCamera("Unmarked");
  HRCamera camera;
  ASSERT_EQ(camera.Load(entity), 0);
  FailOn("qel_set_string_attribute", "@Class=");
  EXPECT_EQ(camera.Save(), model_status::kStringNotWritten);
}

TEST_F(CameraRecordTest, SaveWithoutARecordWritesNothing) {
  HRCamera unstored;
  EXPECT_EQ(unstored.Save(), model_status::kRecordNotOpened);

  const host::EntityHandle entity = StoreCamera("Locked");
  HRCamera camera;
  ASSERT_EQ(camera.Load(entity), 0);
  ClearJournal();
  FailNext("qel_open_attribute_record");
  EXPECT_EQ(camera.Save(), model_status::kRecordNotOpened);
  EXPECT_TRUE(WritesTo(entity).empty());
}

TEST_F(CameraRecordTest, CreateReportsTheRecordWriteResult) {
  FailOn("qel_set_string_attribute", "@CAMNAME=");
  HRCamera camera;
  EXPECT_EQ(camera.Create(), model_status::kStringNotWritten);

  Bench().GetFaults().Clear();
  FailNext("qel_create_group");
  HRCamera unmade;
  EXPECT_EQ(unmade.Create(), model_status::kRecordNotOpened);
  EXPECT_EQ(unmade.GetHandle(), 0);
}

TEST_F(CameraRecordTest, CreateInWritesToTheGivenDrawing) {
  const host::DatabaseHandle current = Bench().Current();
  const host::DatabaseHandle other = Bench().Open(wb::Drawing{});
  HRCamera camera;
  camera.SetSettings(DistinctSettings());
  ASSERT_EQ(camera.CreateIn(other), 0);
  EXPECT_EQ(Bench().Find(current)->LiveCount(), 0U);
  ASSERT_NE(Bench().Find(other)->Find(camera.GetHandle()), nullptr);

  EXPECT_EQ(Bench().Find(other)->Find(camera.GetHandle())->FindAttribute("@Class=")->text, "HRCamera");

  HRCamera loaded;
  ASSERT_EQ(loaded.LoadFrom(other, camera.GetHandle()), 0);
  ExpectSameSettings(SettingsOf(loaded), DistinctSettings());
  EXPECT_TRUE(loaded.IsCamera());
}

TEST_F(CameraRecordTest, CopyTakesTheViewAndResetsEverythingElse) {
  const host::EntityHandle entity = StoreCamera("Original");
  HRCamera original;
  ASSERT_EQ(original.Load(entity), 0);
  original.SetFor2D(1);

  const HRCamera copy = original.Copy(original);
  EXPECT_EQ(copy.GetHandle(), entity);
  EXPECT_EQ(copy.GetName(), "");
  EXPECT_EQ(copy.Get2DFile(), "");
  EXPECT_EQ(copy.GetComment(), "");
  EXPECT_EQ(copy.IsFor2D(), 0);
  EXPECT_FALSE(copy.HasPatterns());

  const CameraSettings settings = SettingsOf(copy);
  const CameraSettings source = DistinctSettings();
  for (int i = 0; i < 3; ++i) {
    EXPECT_EQ(settings.eye[i], source.eye[i]);
    EXPECT_EQ(settings.target[i], source.target[i]);
  }
  EXPECT_EQ(settings.cone, source.cone);
  EXPECT_DOUBLE_EQ(settings.viewWindow[3], source.viewWindow[3]);
  EXPECT_EQ(settings.viewMode, source.viewMode);
  EXPECT_EQ(settings.displayMode, source.displayMode);
  EXPECT_EQ(settings.layers, source.layers);
  EXPECT_EQ(settings.autoClip, 1);
  EXPECT_EQ(settings.scaleMode, 'a');
  EXPECT_EQ(settings.preserveWalls, 0);
  EXPECT_EQ(settings.preserveLayerIndex, 1);
}

TEST_F(CameraRecordTest, DeleteRemovesTheEntityOnceAndThenFails) {
  const host::EntityHandle entity = StoreCamera("Gone");
  HRCamera camera;
  ASSERT_EQ(camera.Load(entity), 0);
  EXPECT_EQ(camera.Delete(), 0);
  EXPECT_EQ(Find(entity), nullptr);
  EXPECT_EQ(camera.Delete(), model_status::kNotDeleted);
}

TEST_F(CameraRecordTest, CamerasComeBackFromASavedDrawingFile) {
  const host::EntityHandle first = StoreCamera("North", "HRCamera", 1.0F);
  HRCamera second;
  CameraSettings settings = DistinctSettings(3.0F);
  settings.scaleMode = ' ';
  settings.viewMode = HRCamera::k2DPerspective;
  second.SetSettings(settings);
  second.SetName("South");
  ASSERT_EQ(second.Create(), 0);

  ReopenThroughFile();
  ASSERT_EQ(GetGeneralCameraCount(), 2);
  HRCamera loaded;
  ASSERT_EQ(LoadGeneralCamera(loaded, 0), 0);
  EXPECT_EQ(loaded.GetHandle(), first);
  EXPECT_EQ(loaded.GetName(), "North");
  ExpectSameSettings(SettingsOf(loaded), DistinctSettings(1.0F));
  ASSERT_EQ(LoadGeneralCamera(loaded, 1), 0);
  EXPECT_EQ(loaded.GetName(), "South");
  ExpectSameSettings(SettingsOf(loaded), settings);
}

}  // namespace
