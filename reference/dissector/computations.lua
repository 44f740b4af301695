-- Computed values: each function takes the numbers of the bytes that it reads, and returns a number or
-- a text, or nothing if nothing is shown.

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

-- The origin of an extent's byte offsets.
local function origin_of(context, extent)
  if extent.of == "record" then return 0 end
  return extent.of == "companion" and context.companion or context.start
end

local function values_of(context, field)
  local values = {}
  for index, extent in ipairs(field.read) do
    local start = origin_of(context, extent)
    if extent.length <= 4 then
      local position = whole_bytes(extent.byte, extent.length)
      values[index] = number_at(context.record, start, position)
    end
  end
  return values
end
