// A fresh host whose current drawing is the model's current database; after each test no host
// memory may be outstanding and no attribute record open.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "model/current_database.h"
#include "workbench/workbench.h"

class ModelTest : public ::testing::Test {
 protected:
  using ChangeRecord = std::pair<host::EntityHandle, std::int32_t>;

  void SetUp() override {
    wb::Workbench::Get().Reset();
    SetCurrentDatabase(wb::Workbench::Get().Current());
  }

  void TearDown() override {
    EXPECT_EQ(Bench().Memory().Outstanding(), 0);
    EXPECT_EQ(Bench().Memory().BadReleases(), 0);
    EXPECT_EQ(Bench().Records().OpenCount(), 0U);
    SetCurrentDatabase(0);
  }

  static wb::Workbench& Bench() { return wb::Workbench::Get(); }
  static host::DatabaseHandle Database() { return Bench().Current(); }
  static wb::Drawing& Drawing() { return Bench().CurrentDrawing(); }
  static wb::Entity* Find(host::EntityHandle entity) { return Drawing().Find(entity); }
  static host::EntityHandle AddEntity(std::uint8_t type) { return Drawing().Add(type).handle; }

  static void AddStringAttribute(host::EntityHandle entity, const std::string& name, const std::string& text) {
    wb::Attribute& attribute = Find(entity)->attributes.emplace_back();
    attribute.name = name;
    attribute.text = text;
  }
  static const wb::Attribute* AttributeOf(host::EntityHandle entity, const std::string& name) {
    const wb::Entity* found = Find(entity);
    return found == nullptr ? nullptr : found->FindAttribute(name.c_str());
  }
  static std::string StringAttribute(host::EntityHandle entity, const std::string& name) {
    const wb::Attribute* attribute = AttributeOf(entity, name);
    return attribute == nullptr ? std::string("<absent>") : attribute->text;
  }

  // The next call of `call` (only its writes of `attribute`, when given) answers `result`.
  static void FailNext(const std::string& call, std::int32_t result = 0, const std::string& attribute = "") {
    wb::FaultRule rule;
    rule.call = call;
    rule.attribute = attribute;
    rule.result = result;
    Bench().GetFaults().Add(rule);
  }

  static std::vector<ChangeRecord> ChangeRecords() { return Bench().GetJournal().ChangeRecords(); }
  static std::vector<std::string> AttributeWrites() {
    return Bench().GetJournal().Names(wb::JournalEntry::Kind::AttributeWrite);
  }
  static std::vector<std::string> HostCalls() { return Bench().GetJournal().Names(wb::JournalEntry::Kind::HostCall); }
  static void ClearJournal() { Bench().GetJournal().Clear(); }
};
