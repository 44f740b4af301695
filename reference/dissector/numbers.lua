-- From here on: the code that interprets the tables.
--
-- Every loop ends with the log record's bytes, and bytes past its end read as zero. Values that depend
-- on earlier packets are computed when the packets are first read in order, and stored by packet.

local HEADER_LENGTH = 13
local STANDARD_TYPE, EXTENDED_TYPE = 1, 255
local EXTENDED_CODES = 0xFF0000
local PREFIX, PREFIX_LENGTH = 0x81, 2
local SUBPACKET_COUNT, FIRST_SUBPACKET = 14, 17
local TRAFFIC = 8 -- the 1x device state

-- Numbers

local function byte_at(record, at)
  return at < record:len() and record(at, 1):uint() or 0
end

local function byte_count(position)
  return math.floor((position.bit + position.width + 7) / 8)
end

-- The number at a position relative to `start`.
local function number_at(record, start, position)
  local count, value = byte_count(position), 0
  for index = 0, count - 1 do
    local place = position.big and count - 1 - index or index
    value = value + byte_at(record, start + position.byte + index) * 256 ^ place
  end
  value = math.floor(value / 2 ^ position.bit) % 2 ^ position.width
  if position.signed and value >= 2 ^ (position.width - 1) then
    value = value - 2 ^ position.width
  end
  return value
end

local function whole_bytes(at, count)
  return { byte = at, bit = 0, width = 8 * count }
end

-- The available bytes from `at` on.
local function range_of(record, at, length)
  local first = math.min(at, record:len())
  return record:range(first, math.min(length, record:len() - first))
end

local function toward_zero(value)
  return value >= 0 and math.floor(value) or math.ceil(value)
end

-- Converts to a signed number with this many bits.
local function signed(value, bits)
  value = value % 2 ^ bits
  return value >= 2 ^ (bits - 1) and value - 2 ^ bits or value
end

-- Rounds to single precision.
local function single(value)
  if value == 0 then return 0 end
  local unit = 2 ^ (math.floor(math.log(math.abs(value)) / math.log(2)) - 23)
  local steps = value / unit
  local below = math.floor(steps)
  local rest = steps - below
  if rest > 0.5 or (rest == 0.5 and below % 2 == 1) then below = below + 1 end
  return below * unit
end

local function decibels(ratio)
  return 10 * math.log(ratio, 10)
end

-- Texts

local function formatted(format, value)
  local number
  if format.real then
    if value ~= value then
      number = string.rep(" ", format.width - 3) .. "nan"
    else
      number = string.format(format.number, value)
    end
  else
    local whole = toward_zero(value)
    number = string.format(format.number, format.unsigned and whole % 2 ^ 32 or signed(whole, 32))
  end
  return (format.before or "") .. number .. (format.behind or "")
end

-- The text of a raw number and, if it is numeric, its value.
local function text_of(field, raw)
  if field.except == raw then return field.except_text end
  if field.format then
    local value = raw * (field.factor or 1) + (field.offset or 0)
    return formatted(field.format, value), value
  end
  local index = field.shift and (raw + field.shift) % 256 or raw
  if field.labels[index] then return field.labels[index] end
  return field.beyond_format and formatted(field.beyond_format, raw) or field.beyond
end

-- State from earlier packets

local function once(context, name, compute)
  local remembered = context.technology.remembered
  local key = context.pinfo.number .. " " .. name
  if not context.pinfo.visited and remembered[key] == nil then
    remembered[key] = compute() or false
  end
  return remembered[key] or nil
end
