// Root of every object class of the model: a class name and a virtual destructor.
#pragma once

#include <string>

class HRObject {
 public:
  HRObject();
  explicit HRObject(std::string className);
  HRObject(const HRObject&) = default;
  HRObject& operator=(const HRObject&) = default;
  virtual ~HRObject();

  const std::string& GetClassName() const { return className_; }
  // Owners rename an embedded object before creating it, so that the "@Class=" marker written
  // with the entity says which owner the entity belongs to.
  void SetClassName(const std::string& className) { className_ = className; }

 private:
  std::string className_;
};
