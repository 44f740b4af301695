-- From here on: how the tables are walked.
--
-- Every loop ends with the record's bytes, and bytes beyond its end read as zero. What depends on
-- the packets before is worked out when they are first read in order, and remembered by packet.

local HEADER_LENGTH = 13
local STANDARD_TYPE, EXTENDED_TYPE = 1, 255
local EXTENDED_CODES = 0xFF0000
local PREFIX, PREFIX_LENGTH = 0x81, 2
local SUBPACKET_COUNT, FIRST_SUBPACKET = 14, 17
local TRAFFIC = 8 -- the 1x device state
local MOST_PROPERTIES = 1000

-- Numbers

local function byte_at(record, at)
  return at < record:len() and record(at, 1):uint() or 0
end

local function byte_count(position)
  return math.floor((position.bit + position.width + 7) / 8)
end

-- The number at a position that counts from `start`.
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

-- The bytes from `at` on, as many of them as there are.
local function range_of(record, at, length)
  local first = math.min(at, record:len())
  return record:range(first, math.min(length, record:len() - first))
end

local function toward_zero(value)
  return value >= 0 and math.floor(value) or math.ceil(value)
end

-- As a signed number of that many bits.
local function signed(value, bits)
  value = value % 2 ^ bits
  return value >= 2 ^ (bits - 1) and value - 2 ^ bits or value
end

-- Rounded to single precision.
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

-- The text of a raw number; of a number also what it is worth.
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

-- What packets leave behind

local function once(context, name, compute)
  local remembered = context.technology.remembered
  local key = context.pinfo.number .. " " .. name
  if not context.pinfo.visited and remembered[key] == nil then
    remembered[key] = compute() or false
  end
  return remembered[key] or nil
end

-- Computed values: each takes the numbers of the bytes that it reads, and gives a number or a text,
-- or nothing where nothing is shown.

local function digit(half)
  return half <= 9 and tostring(math.floor(half)) or " "
end

local function low_digit(byte)
  return digit(byte % 16)
end

local function high_digit(byte)
  return digit(math.floor(byte / 16))
end

local function ecno(first, second, third)
  local energy = first ~= 0 and first or second ~= 0 and second or third
  local level = 0
  for _, band in ipairs(energy_bands) do
    if energy < band[1] then break end
    level = band[2]
  end
  return level
end

local computations = {}

computations["country code"] = function(v)
  return low_digit(v[1]) .. high_digit(v[1]) .. low_digit(v[2])
end

computations["network code"] = function(v)
  return low_digit(v[1]) .. high_digit(v[1]) .. high_digit(v[2])
end

computations["digits"] = function(v)
  return 100 * v[1] + 10 * v[2] + v[3]
end

computations["ecno"] = function(v)
  return ecno(v[1], v[2], v[3])
end

computations["rscp"] = function(v)
  return toward_zero((signed(v[4], 16) + 512) / 10) - 106 + ecno(v[1], v[2], v[3])
end

computations["energy"] = function(v)
  return decibels(v[1] / 512)
end

computations["mean power"] = function(_, _, context)
  local list = context.part.lists[1]
  local layout, field = list.layout, list.fields[1]
  local sum, counted = 0, 0
  for index = 0, number_at(context.record, 0, layout.count) - 1 do
    local start = layout.start + index * layout.stride
    if start + layout.bytes_read > context.record:len() then break end
    local raw = number_at(context.record, start, field.position)
    if raw ~= 0 then
      sum = sum + toward_zero((raw + 512) / 10) - 70
      counted = counted + 1
    end
  end
  return sum / counted
end

computations["bsic"] = function(v, _, context)
  return once(context, "bsic " .. v[1], function()
    local told = context.technology.memory.bsic
    return told and told[v[1]]
  end)
end

computations["data rate"] = function(v, field, context)
  return once(context, field.filter, function()
    local memory, sum = context.technology.memory, 0
    for _, counter in ipairs(field.counters) do
      sum = sum + number_at(context.record, 0, whole_bytes(counter[1], 4)) * counter[2]
    end
    local before = memory[field.filter]
    memory[field.filter] = { sequence = v[1], sum = sum }
    if not before then return "" end
    local steps = signed(v[1] - before.sequence, 32)
    return steps >= 1 and (sum - before.sum) / (steps * 1024) or nil
  end)
end

computations["frame errors"] = function(v, _, context)
  return once(context, "frame errors", function()
    local memory = context.technology.memory
    local rate = v[1] ~= 0 and 1 / 64 or 0
    if memory.frame_errors then
      rate = single(rate + single(memory.frame_errors * 63 / 64))
    end
    memory.frame_errors = rate
    return single(rate * 100)
  end)
end

computations["old frame errors"] = function(v, _, context)
  return once(context, "old frame errors", function()
    local memory = context.technology.memory
    if v[1] == TRAFFIC or not memory.frame_errors then return nil end
    local rate = memory.frame_errors
    memory.frame_errors = nil
    return single(rate * 100)
  end)
end

local function values_of(context, field)
  local values = {}
  for index, extent in ipairs(field.read) do
    local start = context.start
    if extent.of == "record" then start = 0 end
    if extent.of == "companion" then start = context.companion end
    if extent.length <= 4 then
      local position = whole_bytes(extent.byte, extent.length)
      values[index] = number_at(context.record, start, position)
    end
  end
  return values
end

-- Items

local function add_item(context, tree, field, range, text, value)
  local label = field.key ~= "" and field.key .. ": " .. text or text
  local known = context.technology.fields[field.filter]
  if known.is_number and value and value == value then
    tree:add(known.field, range, value, label)
  elseif not known.is_number then
    tree:add(known.field, range, text, label)
  else
    tree:add(range, label) -- a text where others of the key are numbers
  end
end

local function number_of(context, condition)
  local start = condition.subpacket and context.subpackets[condition.subpacket] or context.start
  return number_at(context.record, start, condition.position)
end

local function holds(context, condition)
  local number = number_of(context, condition)
  return number >= condition.least and number <= condition.most
end

local function range_of_field(context, field)
  if field.position then
    local position = field.position
    return range_of(context.record, context.start + position.byte, byte_count(position))
  end
  local extent = field.read[1]
  local start = extent.of == "companion" and context.companion or context.start
  return range_of(context.record, start + extent.byte, extent.length)
end

-- The text that a field shows, and its number where that is one; nothing where it shows nothing.
local function value_of(context, field)
  if field.condition and not holds(context, field.condition) then
    local otherwise = field.condition.otherwise
    if not otherwise or not otherwise:find("%%d") then return otherwise end
    return string.format(otherwise, signed(number_of(context, field.condition), 32))
  end
  if not field.computation then
    return text_of(field, number_at(context.record, context.start, field.position))
  end
  local value = computations[field.computation](values_of(context, field), field, context)
  if type(value) == "number" then return formatted(field.format, value), value end
  return value
end

local function add_field(context, tree, field)
  local text, value = value_of(context, field)
  if text then
    add_item(context, tree, field, range_of_field(context, field), text, value)
  end
end

-- Lists

local add_parts -- defined below: an entry may hold lists

local function run_start(context, run)
  local moved = run.move and run.move * number_at(context.record, context.start, run.moved_by) or 0
  return context.start + run.start + moved
end

local function entry_count(context, layout)
  local count = layout.count and number_at(context.record, context.start, layout.count) or 0
  return count + layout.plus
end

-- Whether the list is shown at all of a record of this length.
local function fits(context, layout, count)
  local length = context.record:len()
  local last = run_start(context, layout) + count * layout.stride
  if layout.fit == "exact" and last ~= length or layout.fit == "all" and last > length then
    return false
  end
  if not layout.other_count then return true end
  local other = layout.other_length * number_at(context.record, context.start, layout.other_count)
  return count ~= 0 and (count * layout.stride) % 256 <= (length - other) % 256
end

-- Whether all that is shown of an entry lies inside the record.
local function is_whole(entry, layout, fields)
  local length = entry.record:len()
  if entry.start + layout.bytes_read > length then return false end
  for _, field in ipairs(fields or {}) do
    local position = field.position
    local is_shown = not field.condition or holds(entry, field.condition)
    if position and is_shown and entry.start + position.byte + byte_count(position) > length then
      return false
    end
  end
  return true
end

local function inside(context, start)
  return setmetatable({ start = start }, { __index = context })
end

-- Calls `see` with each entry that is shown and its index.
local function each_entry(context, list, count, see)
  local layout, length = list.layout, context.record:len()
  local start = run_start(context, layout)
  local companions = layout.companion and run_start(context, layout.companion)
  for index = 0, count - 1 do
    local entry = inside(context, start + index * layout.stride)
    if not is_whole(entry, layout, list.fields) then return end
    if not layout.only or holds(entry, layout.only) then
      if companions then
        entry.companion = companions + index * layout.companion.stride
        if entry.companion + layout.companion.bytes_read > length then return end
      end
      see(entry, index)
    end
  end
end

local function remember(context, list, count)
  if not context.pinfo.visited then
    local told = {}
    each_entry(context, list, count, function(entry)
      local key = number_at(entry.record, entry.start, list.fields[1].position)
      told[key] = number_at(entry.record, entry.start, list.fields[2].position)
    end)
    context.technology.memory[list.layout.remembered_as] = told
  end
end

local function add_entry(context, tree, list, entry, index)
  local layout, field = list.layout, list.fields[1]
  if layout.entry_name then
    local name = string.format("%d;%d", index, number_at(entry.record, entry.start, layout.entry_name))
    local text, value = value_of(entry, field)
    add_item(entry, tree, { key = name, filter = field.filter }, range_of_field(entry, field), text, value)
  elseif field.key == "" then
    add_field(entry, tree, field)
  else
    local range = range_of(context.record, entry.start, layout.stride)
    add_parts(entry, tree:add(range, "Entry " .. index), list)
  end
end

-- The pilots of the 1x active set, whose size and scale the subpacket tells.
local function add_varying(context, tree, list)
  local least = 0.00001
  local layout, field = list.layout, list.fields[1]
  local v = values_of(context, field)
  local divisor, gain, exponent, size, reference = v[1], v[2], v[3], v[4], v[5]
  local stride, energy_at = math.floor((6 * size + 15) / 4) * 4, 4 * size + 24
  for index = 0, entry_count(context, layout) - 1 do
    local start = context.start + index * stride
    if start + energy_at + 2 > context.record:len() then return end
    local pn = number_at(context.record, start, layout.entry_name)
    local energy = number_at(context.record, start, whole_bytes(energy_at, 2))
    local scaled = energy * 2 ^ (2 * exponent - 3)
    local ratio = scaled / (9 * divisor * divisor * gain) - 1 / divisor
    local level = decibels(ratio > least and ratio or least)
    local text = (pn == reference and "(ref pilot) " or "") .. formatted(field.format, level)
    local item = { key = string.format("%d;%d", index, pn), filter = field.filter }
    add_item(context, tree, item, range_of(context.record, start + energy_at, 2), text, level)
  end
end

local function add_list(context, tree, list)
  local layout = list.layout
  if layout.varying then
    return add_varying(context, tree:add(range_of(context.record, context.start, 1), layout.key), list)
  end
  local count = entry_count(context, layout)
  if not fits(context, layout, count) or layout.stays_without_entries and count == 0 then return end
  if layout.remembered_as then remember(context, list, count) end
  local range = range_of(context.record, run_start(context, layout), count * layout.stride)
  if layout.hidden then
    tree = tree:add(range, "Not displayed")
  elseif layout.key ~= "" then
    tree = tree:add(range, layout.key)
  end
  local shown = 0
  each_entry(context, list, count, function(entry, index)
    shown = shown + 1
    add_entry(context, tree, list, entry, index)
  end)
  if shown == 0 and layout.entry_name then tree:append_text(": (none)") end
end

function add_parts(context, tree, part)
  for _, field in ipairs(part.fields or {}) do add_field(context, tree, field) end
  for _, list in ipairs(part.lists or {}) do add_list(context, tree, list) end
end

-- Records

-- Where the subpacket begins; nothing when there is none.
local function subpacket_start(record, id)
  local start = FIRST_SUBPACKET
  for _ = 1, byte_at(record, SUBPACKET_COUNT) do
    local last = start + number_at(record, start, whole_bytes(2, 2))
    if last >= FIRST_SUBPACKET + record:len() then return nil end
    if byte_at(record, start) == id then return start end
    start = last
  end
  return nil
end

local function add_subpackets(context, tree, subpackets)
  for _, subpacket in ipairs(subpackets) do
    context.subpackets[subpacket.id] = subpacket_start(context.record, subpacket.id)
    if not context.subpackets[subpacket.id] then
      return tree:append_text(" (without subpacket " .. subpacket.id .. ")")
    end
  end
  for _, subpacket in ipairs(subpackets) do
    add_parts(inside(context, context.subpackets[subpacket.id]), tree, subpacket)
  end
end

local function add_section(context, root, part)
  local head, length = part.head, context.record:len()
  local tree = root:add(context.record:range(), head.section)
  context = inside(context, 0)
  context.part, context.subpackets = part, {}
  if length < head.least or head.exact and length ~= head.least then
    tree:append_text(" (of another length)")
  elseif head.condition and not holds(context, head.condition) then
    tree:append_text(" (of another version)")
  else
    add_parts(context, tree, part)
    if part.subpackets then add_subpackets(context, tree, part.subpackets) end
  end
end

local function unescaped(text)
  local entities = { lt = "<", gt = ">", amp = "&", quot = '"', apos = "'" }
  return (text:gsub("&(%a+);", entities))
end

-- A serialized property list: of the XML form the keys whose values are simple.
local function add_property_list(record, tree, start)
  if start >= record:len() then return end
  local range = record:range(start)
  local text = range:raw()
  local is_xml = text:find("<plist", 1, true) ~= nil
  local label = (is_xml and "Property list, XML, " or "Property list, ") .. #text .. " bytes"
  local list = tree:add(range, label)
  if not is_xml then return end
  local at = 1
  for _ = 1, MOST_PROPERTIES do
    local first, last, key, kind, value = text:find("<key>([^<]*)</key>%s*<(%a+)>([^<]*)</", at)
    if not first then return end
    if kind ~= "dict" and kind ~= "array" then
      local item = unescaped(key) .. ": " .. unescaped(value)
      list:add(range_of(record, start + first - 1, last - first + 1), item)
    end
    at = last
  end
end

-- The record without its transport prefix; nothing where that leaves nothing.
local function without_prefix(buffer)
  if buffer:len() == 0 then return nil end
  if byte_at(buffer, 0) ~= PREFIX then return buffer end
  if buffer:len() <= PREFIX_LENGTH then return nil end
  return buffer(PREFIX_LENGTH):tvb()
end

local function code_of(record)
  local code = number_at(record, 0, whole_bytes(3, 2))
  return byte_at(record, 0) == EXTENDED_TYPE and EXTENDED_CODES + code or code
end

local function add_header(technology, record, tree, code, name)
  local header = technology.header
  tree:add(header.type, record(0, 1))
  local label = string.format("Log code: 0x%04X", code) .. (name and ", " .. name or "")
  tree:add(header.code, record(3, 2), code, label)
  tree:add(header.name, record(3, 2), name or "", "Name: " .. (name or "unknown"))
  tree:add(header.length, record:range(), record:len())
end

local function dissect_record(technology, buffer, pinfo, tree)
  local record = without_prefix(buffer)
  local is_strict = technology.framing == "record"
  local measured = is_strict and record or buffer
  if not record or measured:len() < HEADER_LENGTH or record:len() < 5 then
    return tree:append_text(" (too short)")
  end
  local code = code_of(record)
  local known = technology.codes[code]
  add_header(technology, record, tree, code, known and known.name)
  pinfo.cols.info = string.format("0x%04X", code) .. (known and " " .. known.name or "")
  local type = byte_at(record, 0)
  if is_strict and type ~= STANDARD_TYPE and type ~= EXTENDED_TYPE then
    return tree:append_text(" (invalid log type)")
  end
  local has_property_list = false
  local context = { technology = technology, record = record, pinfo = pinfo, start = 0 }
  for _, part in ipairs(known or {}) do
    if part.head.property_list then
      has_property_list = true
      tree:add(record:range(), "For " .. part.head.section)
    else
      add_section(context, tree, part)
    end
  end
  if has_property_list then add_property_list(record, tree, HEADER_LENGTH) end
end

-- Registration

local function each_field(part, see)
  for _, field in ipairs(part.fields or {}) do see(field) end
  for _, list in ipairs(part.lists or {}) do each_field(list, see) end
  for _, subpacket in ipairs(part.subpackets or {}) do each_field(subpacket, see) end
end

-- A field to filter by for each key: a number where every value of the key is one.
local function make_fields(technology)
  technology.fields = {}
  local names = {}
  for _, code in pairs(technology.codes) do
    for _, part in ipairs(code) do
      each_field(part, function(field)
        local known = technology.fields[field.filter] or { is_number = true, name = field.key }
        known.is_number = known.is_number and field.format ~= nil
        if not technology.fields[field.filter] then names[#names + 1] = field.filter end
        technology.fields[field.filter] = known
      end)
    end
  end
  local all = {}
  for _, name in ipairs(names) do
    local known = technology.fields[name]
    local make = known.is_number and ProtoField.double or ProtoField.string
    known.field = make(technology.name .. "." .. name, known.name ~= "" and known.name or name)
    all[#all + 1] = known.field
  end
  return all
end

local function register(technology)
  local proto = Proto(technology.name, technology.title .. " log record")
  local fields = make_fields(technology)
  technology.header = {
    type = ProtoField.uint8(technology.name .. ".type", "Log type", base.HEX),
    code = ProtoField.uint32(technology.name .. ".code", "Log code", base.HEX),
    name = ProtoField.string(technology.name .. ".name", "Name"),
    length = ProtoField.uint32(technology.name .. ".length", "Length"),
  }
  for _, field in pairs(technology.header) do fields[#fields + 1] = field end
  proto.fields = fields
  technology.memory, technology.remembered = {}, {}

  function proto.init()
    technology.memory, technology.remembered = {}, {}
  end

  function proto.dissector(buffer, pinfo, root)
    pinfo.cols.protocol = technology.title
    local tree = root:add(proto, buffer())
    if technology.framing == "object" then
      add_property_list(buffer, tree, 0)
    else
      dissect_record(technology, buffer, pinfo, tree)
    end
  end

  DissectorTable.get("wtap_encap"):add(wtap[technology.encapsulation], proto)
end

for _, technology in ipairs(technologies) do register(technology) end
