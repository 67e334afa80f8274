// The camera's attribute record: the full write, and the read with defaults for the keys that
// older records may lack.
#include <cstdio>
#include <functional>
#include <string>

#include "model/status_codes.h"
#include "shell/host/qeldll.h"
#include "views/hr_camera.h"

namespace {

constexpr std::int16_t kFloatFormat = 6;

std::int16_t Flag(std::uint8_t value) { return value != 0 ? 1 : 0; }

// Reads a host text into `out` and releases the host's copy.
host::Status ReadText(host::RecordHandle record, const char* name, std::string& out) {
  char* text = nullptr;
  const host::Status result = qel_read_string_attribute(record, name, &text);
  if (result == host::kOk) out = text != nullptr ? text : "";
  if (text != nullptr) log_free(text);
  return result;
}

// A key with a default: absent keys take the default and count as read.
host::Status WithDefault(host::Status result, const std::function<void()>& applyDefault) {
  if (result == host::kAttributeAbsent) {
    applyDefault();
    return host::kOk;
  }
  return result;
}

}  // namespace

std::int16_t HRCamera::SaveTo(host::DatabaseHandle database) {
  char window[160];
  std::snprintf(window, sizeof window, "%lf %lf %lf %lf", viewWindow_[0], viewWindow_[1], viewWindow_[2],
                viewWindow_[3]);
  std::int16_t status = 0;
  const host::RecordHandle record = qel_open_attribute_record(database, group_.GetEntity(), &status);
  if (status != host::kOk) return model_status::kRecordNotOpened;

  std::int16_t layers[kLayerCount];
  for (int i = 0; i < kLayerCount; ++i) layers[i] = static_cast<std::int16_t>(layers_[static_cast<std::size_t>(i)]);

  // The writes run in this order and stop at the first one the host refuses.
  const std::function<host::Status()> writes[] = {
      [&] { return qel_set_float_vector_attribute(record, "@EYE=", eye_, 3, kFloatFormat); },
      [&] { return qel_set_float_vector_attribute(record, "@TARGET=", target_, 3, kFloatFormat); },
      [&] { return qel_set_float_attribute(record, "@CONE=", cone_, kFloatFormat); },
      [&] { return qel_set_short_attribute(record, "@VIEWMODE=", viewMode_); },
      [&] { return qel_set_short_vector_attribute(record, "@LYRCFG=", layers, kLayerCount); },
      [&] { return qel_set_string_attribute(record, "@CAMNAME=", name_.c_str()); },
      [&] { return qel_set_short_attribute(record, "@DSP=", displayMode_); },
      [&] { return qel_set_string_attribute(record, "@CONF=", window); },
      [&] { return qel_set_short_attribute(record, "@S2D=", static_cast<std::int16_t>(for2D_)); },
      [&] { return qel_set_string_attribute(record, "@2DFILE=", file2D_.c_str()); },
      [&] { return qel_set_string_attribute(record, "@COMMENT=", comment_.c_str()); },
      [&] { return qel_set_short_attribute(record, "@PATTERN=", Flag(patterns_)); },
      [&] { return qel_set_short_attribute(record, "@SHOWSEC=", Flag(showSections_)); },
      [&] { return qel_set_short_attribute(record, "@AUTOCLIP=", Flag(autoClip_)); },
      [&] { return qel_set_short_attribute(record, "@S2DOVERWRITE=", Flag(overwrite2D_)); },
      [&] { return qel_set_short_attribute(record, "@CLINE=", Flag(removeCoincident_)); },
      [&] { return qel_set_short_attribute(record, "@LINEMERGE=", Flag(lineMerge_)); },
      [&] { return qel_set_short_attribute(record, "@SCALE=", static_cast<std::int16_t>(scaleMode_)); },
      [&] { return qel_set_short_attribute(record, "@PRESDIM=", Flag(preserveDimensions_)); },
      [&] { return qel_set_short_attribute(record, "@PRESLYR=", Flag(preserveLayer_)); },
      [&] { return qel_set_short_attribute(record, "@PRESLYRN=", preserveLayerIndex_); },
      [&] { return qel_set_short_attribute(record, "@PRESTXT=", Flag(preserveText_)); },
      [&] { return qel_set_short_attribute(record, "@PRESWLS=", Flag(preserveWalls_)); },
  };
  bool written = true;
  for (const auto& write : writes) {
    if (write() != host::kOk) {
      written = false;
      break;
    }
  }
  // The marker goes last, only onto a complete record, and into this record's own drawing: the
  // attribute family would write it into the current drawing, onto whatever entity has this
  // handle there. Without it the camera does not load, so a refused marker is a failed save.
  if (written) written = qel_set_string_attribute(record, "@Class=", GetClassName().c_str()) == host::kOk;
  qel_close_attribute_record(database, record);
  return written ? model_status::kSuccess : model_status::kStringNotWritten;
}

std::int16_t HRCamera::LoadFrom(host::DatabaseHandle database, host::EntityHandle entity) {
  if (const std::int16_t result = group_.Read(database, entity); result != 0) return result;
  std::int16_t status = 0;
  const host::RecordHandle record = qel_open_attribute_record(database, entity, &status);
  if (status != host::kOk) return model_status::kRecordNotOpened;

  std::int16_t layers[kLayerCount] = {};
  std::string className;
  std::string window;
  std::int16_t for2D = 0;
  std::int16_t value = 0;

  // Each step reads one key; the first failure ends the read.
  const auto readFlag = [&](const char* name, std::uint8_t& flag, bool required, std::uint8_t fallback) {
    const host::Status result = qel_read_short_attribute(record, name, &value);
    if (result == host::kOk) {
      flag = value != 0 ? 1 : 0;
      return result;
    }
    return required ? result : WithDefault(result, [&] { flag = fallback; });
  };
  const std::function<host::Status()> reads[] = {
      [&] { return qel_read_fixed_float_vector(record, "@EYE=", eye_, 3); },
      [&] { return qel_read_fixed_float_vector(record, "@TARGET=", target_, 3); },
      [&] { return qel_read_float_attribute(record, "@CONE=", &cone_); },
      [&] { return qel_read_short_attribute(record, "@VIEWMODE=", &viewMode_); },
      [&] { return qel_read_fixed_short_vector(record, "@LYRCFG=", layers, kLayerCount); },
      [&] { return ReadText(record, "@CAMNAME=", name_); },
      [&] { return ReadText(record, "@Class=", className); },
      [&] {
        const host::Status result = ReadText(record, "@CONF=", window);
        if (result == host::kOk) {
          std::sscanf(window.c_str(), "%lf %lf %lf %lf", &viewWindow_[0], &viewWindow_[1], &viewWindow_[2],
                      &viewWindow_[3]);
        }
        return result;
      },
      [&] { return qel_read_short_attribute(record, "@DSP=", &displayMode_); },
      [&] { return qel_read_short_attribute(record, "@S2D=", &for2D); },
      [&] { return WithDefault(ReadText(record, "@2DFILE=", file2D_), [&] { file2D_.clear(); }); },
      [&] { return WithDefault(ReadText(record, "@COMMENT=", comment_), [&] { comment_.clear(); }); },
      [&] { return readFlag("@PATTERN=", patterns_, true, 0); },
      [&] { return readFlag("@SHOWSEC=", showSections_, true, 0); },
      [&] { return readFlag("@AUTOCLIP=", autoClip_, false, 1); },
      [&] { return readFlag("@S2DOVERWRITE=", overwrite2D_, false, 1); },
      [&] { return readFlag("@CLINE=", removeCoincident_, false, 1); },
      [&] { return readFlag("@LINEMERGE=", lineMerge_, false, 1); },
      [&] {
        const host::Status result = qel_read_short_attribute(record, "@SCALE=", &value);
        if (result == host::kOk) scaleMode_ = static_cast<char>(value & 0xFF);
        return WithDefault(result, [&] { scaleMode_ = 'a'; });
      },
      [&] { return readFlag("@PRESDIM=", preserveDimensions_, false, 0); },
      [&] { return readFlag("@PRESTXT=", preserveText_, false, 0); },
      [&] { return readFlag("@PRESLYR=", preserveLayer_, false, 0); },
      [&] {
        return WithDefault(qel_read_short_attribute(record, "@PRESLYRN=", &preserveLayerIndex_),
                           [&] { preserveLayerIndex_ = 0; });
      },
      [&] { return readFlag("@PRESWLS=", preserveWalls_, false, 0); },
  };
  std::int16_t outcome = model_status::kSuccess;
  for (const auto& read : reads) {
    if (read() != host::kOk) {
      outcome = model_status::kAttributeFailed;
      break;
    }
  }
  qel_close_attribute_record(database, record);
  if (outcome == model_status::kSuccess) {
    for (int i = 0; i < kLayerCount; ++i) layers_[static_cast<std::size_t>(i)] = static_cast<std::uint16_t>(layers[i]);
    for2D_ = static_cast<std::uint16_t>(for2D);
    HRObject::SetClassName(className);
  }
  return outcome;
}
