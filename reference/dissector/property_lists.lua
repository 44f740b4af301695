-- Property lists: the bytes of a serialized object as a tree of nodes.
--
-- A node has its kind ("string", "integer", "real", "boolean", "data", "date", "array" or
-- "dictionary") and its byte range; a scalar has its text, a number also its value. Inputs that Pallax
-- refuses are refused here too. The limits of depth and size are lower than in Pallax, and unusual XML
-- is not read.

local DEEPEST_LIST, MOST_VALUES = 64, 20000
local MOST_EXPANDED = 65536 -- bytes of texts, in addition to those of the list
local SECONDS_OF_DAY = 86400
local REFUSAL = "no property list that can be read"

local function refuse()
  error(REFUSAL, 0)
end

local function count_value(source, depth)
  source.values = source.values + 1
  if source.values > MOST_VALUES or depth > DEEPEST_LIST then refuse() end
end

-- If the pattern comes next, advances past it and returns its captures, or true.
local function take(source, pattern)
  local first, last, found, other = source.bytes:find("^" .. pattern, source.next)
  if first then source.next = last + 1 end
  return found or first and true, other
end

local function new_dictionary()
  return { kind = "dictionary", entries = {}, places = {} }
end

-- A repeated key keeps its first position and its last value.
local function set_entry(dictionary, key, value)
  local known = dictionary.places[key]
  if known then
    known.value = value
  else
    local entry = { key = key, value = value }
    dictionary.entries[#dictionary.entries + 1] = entry
    dictionary.places[key] = entry
  end
end

-- The node under a key; nothing if it is missing or the parent is not a dictionary.
local function find(node, key)
  local entry = node.kind == "dictionary" and node.places[key]
  return entry and entry.value or nil
end

-- The number of a node if it is a signed 32-bit number.
local function int32_of(node)
  local number = node.number
  local is_whole = number and number == math.floor(number)
  return is_whole and number >= -2 ^ 31 and number < 2 ^ 31 and number or nil
end

-- UTF-8

local UTF8_SHAPES = {
  "^[\194-\223][\128-\191]()",
  "^\224[\160-\191][\128-\191]()",
  "^[\225-\236\238\239][\128-\191][\128-\191]()",
  "^\237[\128-\159][\128-\191]()",
  "^\240[\144-\191][\128-\191][\128-\191]()",
  "^[\241-\243][\128-\191][\128-\191][\128-\191]()",
  "^\244[\128-\143][\128-\191][\128-\191]()",
}

local function past_character(text, at)
  for _, shape in ipairs(UTF8_SHAPES) do
    local past = text:match(shape, at)
    if past then return past end
  end
  return nil
end

local function is_utf8(text)
  local at = text:find("[\128-\255]")
  while at do
    local past = past_character(text, at)
    if not past then return false end
    at = text:find("[\128-\255]", past)
  end
  return true
end

local function utf8_of(code)
  local function follower(place)
    return 0x80 + math.floor(code / 64 ^ place) % 64
  end
  if code < 0x80 then return string.char(code) end
  if code < 0x800 then return string.char(0xC0 + math.floor(code / 64), follower(0)) end
  if code < 0x10000 then
    return string.char(0xE0 + math.floor(code / 64 ^ 2), follower(1), follower(0))
  end
  return string.char(0xF0 + math.floor(code / 64 ^ 3), follower(2), follower(1), follower(0))
end

-- Texts of scalars, as `pallax decode` writes them

-- The shortest text that reads back the same; without an exponent if that is not longer.
local function real_text(number)
  if number ~= number or math.abs(number) == math.huge then return "null" end
  local text
  for precision = 0, 16 do
    text = string.format("%." .. precision .. "e", number)
    if tonumber(text) == number then break end
  end
  local sign, digits, power = text:match("^(%-?)([%d.]+)e([+-]%d+)$")
  digits, power = digits:gsub("%.", ""), tonumber(power)
  local plain
  if power >= #digits - 1 then
    plain = digits .. string.rep("0", power + 1 - #digits)
  elseif power >= 0 then
    plain = digits:sub(1, power + 1) .. "." .. digits:sub(power + 2)
  else
    plain = "0." .. string.rep("0", -power - 1) .. digits
  end
  if #sign + #plain > #text then return text end
  return math.abs(number) >= 2 ^ 53 and string.format("%.0f", number) or sign .. plain
end

local BASE64 = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/"

local function base64_text(bytes)
  local letters = {}
  for at = 1, #bytes, 3 do
    local first, second, third = bytes:byte(at, at + 2)
    local group = first * 65536 + (second or 0) * 256 + (third or 0)
    for place = 3, 0, -1 do
      local digit = math.floor(group / 64 ^ place) % 64 + 1
      letters[#letters + 1] = BASE64:sub(digit, digit)
    end
    if not third then letters[#letters] = "=" end
    if not second then letters[#letters - 1] = "=" end
  end
  return table.concat(letters)
end

-- The same for a base64 text, which may contain white space; nothing if it is invalid.
local function checked_base64(text)
  text = text:gsub("[ \t\r\n]", "")
  local digits, padding = text:match("^([A-Za-z0-9+/]*)(=?=?)$")
  if not digits or #text % 4 ~= 0 then return nil end
  local last = BASE64:find(digits:sub(-1), 1, true)
  local unused = padding == "=" and 4 or padding == "==" and 16 or 1
  return (digits == "" or (last - 1) % unused == 0) and text or nil
end

local function is_leap(year)
  return year % 4 == 0 and year % 100 ~= 0 or year % 400 == 0
end

-- "2023-11-14T22:13:20Z" if it is a date, otherwise nothing.
local function checked_date(text)
  local year, month, day, hour, minute, second =
    text:match("^(%d%d%d%d)%-(%d%d)%-(%d%d)T(%d%d):(%d%d):(%d%d)Z$")
  if not year then return nil end
  local lengths = { 31, is_leap(tonumber(year)) and 29 or 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31 }
  local length = lengths[tonumber(month)]
  local is_date = length and tonumber(day) >= 1 and tonumber(day) <= length
  return is_date and tonumber(hour) < 24 and tonumber(minute) < 60 and tonumber(second) < 60
    and text or nil
end

-- The same for seconds since 2001; nothing outside the years 0 to 9999. Years start in March, so that
-- the leap day is the last.
local function date_text(seconds)
  if not (math.abs(seconds) < 1e12) then return nil end
  seconds = math.floor(seconds)
  local days = math.floor(seconds / SECONDS_OF_DAY)
  local rest = seconds - days * SECONDS_OF_DAY
  days = days + 730791 -- since the first of March of the year 0
  local era = math.floor(days / 146097)
  days = days - era * 146097
  local year = math.floor((days - math.floor(days / 1460) + math.floor(days / 36524)
    - math.floor(days / 146096)) / 365)
  days = days - 365 * year - math.floor(year / 4) + math.floor(year / 100)
  local month = math.floor((5 * days + 2) / 153)
  local day = days - math.floor((153 * month + 2) / 5) + 1
  year = year + 400 * era + (month >= 10 and 1 or 0)
  month = month + (month >= 10 and -9 or 3)
  if year < 0 or year > 9999 then return nil end
  return string.format("%04.0f-%02.0f-%02.0fT%02.0f:%02.0f:%02.0fZ", year, month, day,
    math.floor(rest / 3600), math.floor(rest / 60) % 60, rest % 60)
end
