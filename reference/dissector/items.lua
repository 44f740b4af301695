-- Items

-- An item with its label and, under `filter`, its filter field if that is known.
local function add_labelled(context, tree, filter, range, text, value, label)
  local known = filter and context.technology.fields[filter]
  if known and known.is_number and value and value == value then
    tree:add(known.field, range, value, label)
  elseif known and not known.is_number then
    tree:add(known.field, range, text, label)
  else
    tree:add(range, label) -- also for a text if other values of the key are numbers
  end
end

local function add_item(context, tree, field, range, text, value)
  local label = field.key ~= "" and field.key .. ": " .. text or text
  add_labelled(context, tree, field.filter, range, text, value, label)
end

local function number_of(context, condition)
  local start = condition.subpacket and context.subpackets[condition.subpacket] or context.start
  return number_at(context.record, start, condition.position)
end

local function holds(context, condition)
  local number = number_of(context, condition)
  return number >= condition.least and number <= condition.most
end

-- The bytes of a field; for a computed field, from the first to the last byte read in the same place as
-- its first extent.
local function range_of_field(context, field)
  if field.position then
    local position = field.position
    return range_of(context.record, context.start + position.byte, byte_count(position))
  end
  local of, first, last = field.read[1].of, math.huge, 0
  for _, extent in ipairs(field.read) do
    if extent.of == of then
      first = math.min(first, extent.byte)
      last = math.max(last, extent.byte + extent.length)
    end
  end
  local start = origin_of(context, field.read[1])
  return range_of(context.record, start + first, last - first)
end

-- The text of a field, and its number if it has one; nothing if it is not shown.
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

local add_parts -- defined below: an entry may contain lists

local function run_start(context, run)
  local moved = run.move and run.move * number_at(context.record, context.start, run.moved_by) or 0
  return context.start + run.start + moved
end

local function entry_count(context, layout)
  local count = layout.count and number_at(context.record, context.start, layout.count) or 0
  return count + layout.plus
end

-- Whether a log record of this length shows the list at all.
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

-- Whether all displayed parts of an entry are inside the log record.
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

-- Calls `see` with each displayed entry and its index.
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

-- The pilots of the 1x active set; the subpacket gives their number and scale.
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
