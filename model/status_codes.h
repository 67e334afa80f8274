// Results of the entity model's operations: 0 for success, one negative code per failure.
// Callers and stored behaviour depend on the exact numbers.
#pragma once

#include <cstdint>

namespace model_status {

constexpr std::int16_t kSuccess = 0;
constexpr std::int16_t kHeaderNotRead = -2;
constexpr std::int16_t kHeaderNotUpdated = -3;
constexpr std::int16_t kWrongEntity = -4;           // wrong type, or its own record not read
constexpr std::int16_t kBlockNotCreated = -5;       // also: block members not listed on read
constexpr std::int16_t kRecordNotUpdated = -6;
constexpr std::int16_t kNotDeleted = -7;            // block or group
constexpr std::int16_t kMemberNotAdded = -8;
constexpr std::int16_t kRecordNotOpened = -9;       // attribute record
constexpr std::int16_t kStringNotWritten = -10;
constexpr std::int16_t kAttributeFailed = -11;
constexpr std::int16_t kGroupNotCreated = -13;
constexpr std::int16_t kElementNotWritten = -14;    // element not added or updated, or its record not opened
constexpr std::int16_t kElementNotDeleted = -16;
constexpr std::int16_t kLineNotRead = -17;
constexpr std::int16_t kLineNotAdded = -18;
constexpr std::int16_t kLineNotUpdated = -19;
constexpr std::int16_t kEntityNotDeleted = -20;
constexpr std::int16_t kMembersNotUnlinked = -21;
constexpr std::int16_t kPlacedBlockNotRead = -24;
constexpr std::int16_t kPlacedBlockNotAdded = -25;
constexpr std::int16_t kPlacedBlockNotUpdated = -26;
constexpr std::int16_t kTextNotWritten = -27;
constexpr std::int16_t kMemberListNotObtained = -29;

}  // namespace model_status
