-- The binary form: "bplist00", the objects, a table of their offsets, and a trailer. Offsets count
-- from 0; numbers are big-endian.

local HEADER, TRAILER = "bplist00", 32
local INTEGER, DATA, ASCII, UTF16, UTF8, ARRAY, DICTIONARY = 1, 4, 5, 6, 7, 10, 13

local function big_endian(source, at, width, limit)
  if at + width > limit then refuse() end
  local number = 0.0
  for index = at + 1, at + width do number = number * 256 + source.bytes:byte(index) end
  return number
end

-- Reads the trailer.
local function open_binary(source)
  local size = #source.bytes
  local trailer = size - TRAILER
  if source.bytes:sub(1, #HEADER) ~= HEADER or trailer < #HEADER then refuse() end
  source.offset_width = big_endian(source, trailer + 6, 1, size)
  source.width = big_endian(source, trailer + 7, 1, size)
  source.count = big_endian(source, trailer + 8, 8, size)
  source.root = big_endian(source, trailer + 16, 8, size)
  source.objects_end = big_endian(source, trailer + 24, 8, size)
  local is_sound = source.offset_width >= 1 and source.offset_width <= 8
    and source.width >= 1 and source.width <= 8
    and source.objects_end > #HEADER and source.objects_end <= trailer
    and source.count * source.offset_width == trailer - source.objects_end
    and source.root < source.count
  if not is_sound then refuse() end
  source.scalars = {}
  source.payload = size + MOST_EXPANDED
end

local function offset_of(source, reference)
  if reference >= source.count then refuse() end
  local at = source.objects_end + reference * source.offset_width
  local offset = big_endian(source, at, source.offset_width, #source.bytes)
  if offset < #HEADER or offset >= source.objects_end then refuse() end
  return offset
end

local function marker_at(source, offset)
  local byte = source.bytes:byte(offset + 1)
  local marker = { kind = math.floor(byte / 16), low = byte % 16, content = offset + 1 }
  local kind = marker.kind
  marker.count = marker.low
  local is_counted = kind >= DATA and kind <= UTF8 or kind == ARRAY or kind == DICTIONARY
  if is_counted and marker.low == 15 then
    local size = big_endian(source, marker.content, 1, source.objects_end) - 16 * INTEGER
    if size < 0 or size > 3 then refuse() end
    marker.count = big_endian(source, marker.content + 1, 2 ^ size, source.objects_end)
    marker.content = marker.content + 1 + 2 ^ size
  end
  return marker
end

-- The content of an object whose units have `unit` bytes each.
local function content_of(source, marker, unit)
  marker.past = marker.content + marker.count * unit
  if marker.past > source.objects_end then refuse() end
  return source.bytes:sub(marker.content + 1, marker.past)
end

-- Texts and data may overlap; their expansion is limited in proportion to the bytes.
local function spend(source, size)
  source.payload = source.payload - size
  if source.payload < 0 then refuse() end
end

local function text_of_utf16(units)
  local letters, at = {}, 1
  while at < #units do
    local code = units:byte(at) * 256 + units:byte(at + 1)
    at = at + 2
    if code >= 0xD800 and code <= 0xDFFF then
      local low = at < #units and units:byte(at) * 256 + units:byte(at + 1) or 0
      if code >= 0xDC00 or low < 0xDC00 or low > 0xDFFF then refuse() end
      code = 0x10000 + (code - 0xD800) * 1024 + low - 0xDC00
      at = at + 2
    end
    letters[#letters + 1] = utf8_of(code)
  end
  return table.concat(letters)
end

local function binary_text(source, marker)
  local bytes = content_of(source, marker, marker.kind == UTF16 and 2 or 1)
  spend(source, #bytes)
  if marker.kind == UTF16 then return text_of_utf16(bytes) end
  if marker.kind == ASCII and bytes:find("[\128-\255]") or not is_utf8(bytes) then refuse() end
  return bytes
end

-- 1, 2 or 4 bytes are unsigned, 8 signed; 16 are accepted if the number fits 64 bits, signed or
-- unsigned.
local function binary_integer(source, marker)
  if marker.low > 4 then refuse() end
  local at, width, is_unsigned = marker.content, 2 ^ marker.low, false
  marker.past = at + width
  if width == 16 then
    local high = source.bytes:sub(at + 1, at + 8)
    width, at = 8, at + 8
    local is_top_bit_set = big_endian(source, at, 1, source.objects_end) >= 128
    is_unsigned = high == string.rep("\0", 8)
    if not is_unsigned and (high ~= string.rep("\255", 8) or not is_top_bit_set) then refuse() end
  end
  if width < 8 then
    local number = big_endian(source, at, width, source.objects_end)
    return number, string.format("%.0f", number)
  end
  -- In halves, with the text computed separately: a Lua number may not hold all of the bits.
  local low = big_endian(source, at + 4, 4, source.objects_end)
  local high = big_endian(source, at, 4, source.objects_end)
  local range = source.range:range(at, 8)
  if is_unsigned then return high * 2 ^ 32 + low, tostring(range:uint64()) end
  return signed(high, 32) * 2 ^ 32 + low, tostring(range:int64())
end

local function binary_real(source, marker)
  if marker.low ~= 2 and marker.low ~= 3 then refuse() end
  marker.past = marker.content + 2 ^ marker.low
  if marker.past > source.objects_end then refuse() end
  return source.range:range(marker.content, 2 ^ marker.low):float()
end

local scalars = {}

scalars[0] = function(_, marker)
  if marker.low ~= 8 and marker.low ~= 9 then refuse() end
  marker.past = marker.content
  return { kind = "boolean", text = marker.low == 9 and "true" or "false" }
end

scalars[INTEGER] = function(source, marker)
  local number, text = binary_integer(source, marker)
  return { kind = "integer", number = number, text = text }
end

scalars[2] = function(source, marker)
  local number = binary_real(source, marker)
  return { kind = "real", number = number, text = real_text(number) }
end

scalars[3] = function(source, marker)
  local text = marker.low == 3 and date_text(binary_real(source, marker))
  return { kind = "date", text = text or refuse() }
end

scalars[DATA] = function(source, marker)
  local bytes = content_of(source, marker, 1)
  spend(source, #bytes)
  return { kind = "data", text = base64_text(bytes) }
end

scalars[ASCII] = function(source, marker)
  return { kind = "string", text = binary_text(source, marker) }
end
scalars[UTF16], scalars[UTF8] = scalars[ASCII], scalars[ASCII]

local function binary_scalar(source, offset, marker)
  local known = source.scalars[offset]
  if known then return known end
  local read = scalars[marker.kind] or refuse()
  local node = read(source, marker)
  node.at, node.length = offset, marker.past - offset
  source.scalars[offset] = node
  return node
end

-- The maximum depth also ends circular references.
local function binary_value(source, offset, depth)
  count_value(source, depth)
  local marker = marker_at(source, offset)
  local is_dictionary = marker.kind == DICTIONARY
  if not is_dictionary and marker.kind ~= ARRAY then
    return binary_scalar(source, offset, marker)
  end
  content_of(source, marker, (is_dictionary and 2 or 1) * source.width)
  local function reference(index)
    local at = marker.content + index * source.width
    return offset_of(source, big_endian(source, at, source.width, source.objects_end))
  end
  local node = is_dictionary and new_dictionary() or { kind = "array", elements = {} }
  for index = 0, marker.count - 1 do
    if is_dictionary then
      local value = binary_value(source, reference(marker.count + index), depth + 1)
      local key_offset = reference(index)
      local key = binary_scalar(source, key_offset, marker_at(source, key_offset))
      if key.kind == "string" then
        set_entry(node, key.text, value)
      else
        node.entries[#node.entries + 1] = { value = value } -- counted, but never displayed
      end
    else
      node.elements[index + 1] = binary_value(source, reference(index), depth + 1)
    end
  end
  node.at, node.length = offset, marker.past - offset
  return node
end

local function read_binary(source)
  open_binary(source)
  return binary_value(source, offset_of(source, source.root), 1)
end
