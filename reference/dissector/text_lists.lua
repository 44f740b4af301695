-- The old text form: { key = value; }, ( a, b ), <0fbd77>, "quoted" or bare strings, comments as in
-- C++.

local ESCAPES = {
  a = "\a", b = "\b", f = "\f", n = "\n", r = "\r", t = "\t", v = "\v",
  ['"'] = '"', ["'"] = "'", ["\\"] = "\\", ["\n"] = "\n",
}

local function skip_text_space(source)
  repeat
    take(source, "[ \t-\r]*")
    local is_comment = take(source, "//[^\r\n]*")
    if take(source, "/%*") then
      local _, last = source.bytes:find("*/", source.next, true)
      source.next = (last or refuse()) + 1
      is_comment = true
    end
  until not is_comment
end

-- The code point after "\U"; two escapes may form one.
local function unicode_escape(source)
  local code = tonumber(take(source, "[Uu](%x%x%x%x)") or refuse(), 16)
  if code < 0xD800 or code > 0xDFFF then return utf8_of(code) end
  local low = tonumber(take(source, "\\[Uu](%x%x%x%x)") or refuse(), 16)
  if code >= 0xDC00 or low < 0xDC00 or low > 0xDFFF then refuse() end
  return utf8_of(0x10000 + (code - 0xD800) * 1024 + low - 0xDC00)
end

local function escape(source)
  local octal = take(source, "([0-7][0-7]?[0-7]?)")
  if octal then
    local code = tonumber(octal, 8)
    return code <= 0xFF and utf8_of(code) or refuse()
  end
  if source.bytes:find("^[Uu]", source.next) then return unicode_escape(source) end
  return ESCAPES[take(source, "(.)") or refuse()] or refuse()
end

local function string_of(source)
  local quote = take(source, "([\"'])")
  if not quote then return take(source, "([A-Za-z0-9_$/:.-]+)") or refuse() end
  local pieces = {}
  while not take(source, quote) do
    local piece = take(source, "([^\\" .. quote .. "]+)")
    pieces[#pieces + 1] = piece or take(source, "\\") and escape(source) or refuse()
  end
  return table.concat(pieces)
end

local function data_of(source)
  local digits = take(source, "<([%x \t-\r]*)>") or refuse()
  digits = digits:gsub("%X", "")
  if #digits % 2 ~= 0 then refuse() end
  return base64_text((digits:gsub("%x%x", function(byte) return string.char(tonumber(byte, 16)) end)))
end

local text_value -- defined below: containers are recursive

local function fill_text_container(source, node, depth)
  local is_array = node.kind == "array"
  local closing, separator = is_array and "%)" or "}", is_array and "," or ";"
  skip_text_space(source)
  while not take(source, closing) do
    if is_array then
      node.elements[#node.elements + 1] = text_value(source, depth + 1)
    else
      local key = string_of(source)
      skip_text_space(source)
      if not take(source, "=") then refuse() end
      set_entry(node, key, text_value(source, depth + 1))
    end
    skip_text_space(source)
    local is_followed = take(source, separator)
    skip_text_space(source)
    if not is_followed and not source.bytes:find("^" .. closing, source.next) then refuse() end
  end
end

function text_value(source, depth)
  skip_text_space(source)
  count_value(source, depth)
  local first = source.next
  local node
  if take(source, "{") then
    node = new_dictionary()
    fill_text_container(source, node, depth)
  elseif take(source, "%(") then
    node = { kind = "array", elements = {} }
    fill_text_container(source, node, depth)
  elseif source.bytes:find("^<", first) then
    node = { kind = "data", text = data_of(source) }
  else
    node = { kind = "string", text = string_of(source) }
  end
  node.at, node.length = first - 1, source.next - first
  return node
end

local function read_text(source)
  if not is_utf8(source.bytes) then refuse() end
  source.next = 1
  take(source, "\239\187\191")
  local node = text_value(source, 1)
  skip_text_space(source)
  if source.next <= #source.bytes then refuse() end
  return node
end
