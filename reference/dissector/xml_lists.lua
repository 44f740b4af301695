-- The XML form as programs write it: reads a declaration, a document type, comments between elements,
-- and references, but no attributes (except the list's version), CDATA sections or comments inside
-- texts.

local ENTITIES = { lt = "<", gt = ">", amp = "&", quot = '"', apos = "'" }

-- White space and comments.
local function skip_xml_space(source)
  take(source, "%s*")
  while take(source, "<!%-%-") do
    local _, last = source.bytes:find("-->", source.next, true)
    source.next = (last or refuse()) + 1
    take(source, "%s*")
  end
end

local function character(digits)
  local code = digits:match("^x%x+$") and tonumber(digits:sub(2), 16)
    or digits:match("^%d+$") and tonumber(digits, 10)
  local is_character = code and code <= 0x10FFFF and (code < 0xD800 or code > 0xDFFF)
    and (code >= 0x20 or code == 9 or code == 10 or code == 13)
  return is_character and utf8_of(code) or refuse()
end

-- A text with its references replaced.
local function plain_text(text)
  text = text:gsub("\r\n?", "\n")
  local rest = text:gsub("&#?%w+;", "")
  if rest:find("&", 1, true) then refuse() end
  text = text:gsub("&(#?)(%w+);", function(number, name)
    return number == "#" and character(name) or ENTITIES[name] or refuse()
  end)
  return text
end

-- The text up to the end tag of an element, and its position.
local function text_of_element(source, name)
  local at = source.next
  local text = take(source, "([^<]*)")
  local past = source.next
  if not take(source, "</" .. name .. "%s*>") then refuse() end
  return plain_text(text), at, past
end

local function trimmed(text)
  return text:match("^[ \t\r\n]*(.-)[ \t\r\n]*$")
end

-- The number and its text, with any number of digits.
local function integer_of(text)
  local sign, digits = trimmed(text):match("^([+-]?)(%d+)$")
  if not sign then
    sign, digits = trimmed(text):match("^([+-]?)0[xX](%x+)$")
    if not sign or #digits:gsub("^0+", "") > 13 then refuse() end
    digits = string.format("%.0f", tonumber(digits, 16))
  end
  digits = digits:gsub("^0+(%d)", "%1")
  sign = sign == "-" and digits ~= "0" and "-" or ""
  local largest = sign == "-" and "9223372036854775808" or "18446744073709551615"
  if #digits > #largest or #digits == #largest and digits > largest then refuse() end
  return tonumber(sign .. digits), sign .. digits
end

local function real_of(text)
  local sign, digits = trimmed(text):match("^([+-]?)(.*)$")
  local lower, number = digits:lower(), nil
  if lower == "nan" then
    number = 0 / 0
  elseif lower == "inf" or lower == "infinity" then
    number = math.huge
  else
    local significand = digits:match("^([%d.]+)$") or digits:match("^([%d.]+)[eE][+-]?%d+$")
    local is_real = significand and significand:find("^%d*%.?%d*$") and significand:find("%d")
    number = (is_real and tonumber(digits) or refuse()) + 0.0 -- a real, even if Lua has integers
    local is_in_range = number > 0 and number < math.huge
    if not is_in_range and significand:find("[1-9]") then refuse() end
  end
  return sign == "-" and -number or number
end

local xml_scalars = {}

xml_scalars.string = function(text) return text end
xml_scalars.integer = function(text)
  local number, digits = integer_of(text)
  return digits, number
end
xml_scalars.real = function(text)
  local number = real_of(text)
  return real_text(number), number
end
xml_scalars.data = function(text) return checked_base64(text) end
xml_scalars.date = function(text) return checked_date(trimmed(text)) end

local function xml_scalar(source, name, first, is_empty)
  local text, at, past = "", first, first
  if not is_empty then text, at, past = text_of_element(source, name) end
  local node = { kind = name }
  if name == "true" or name == "false" then
    if trimmed(text) ~= "" then refuse() end
    node.kind, node.text = "boolean", name
  else
    local read = xml_scalars[name] or refuse()
    node.text, node.number = read(text)
    if not node.text then refuse() end
  end
  if at == past then at, past = first, source.next end -- if empty, the element itself
  node.at, node.length = at - 1, past - at
  return node
end

local xml_value -- defined below: containers are recursive

local function fill_container(source, node, depth)
  skip_xml_space(source)
  while not take(source, "</" .. (node.elements and "array" or "dict") .. "%s*>") do
    if node.elements then
      node.elements[#node.elements + 1] = xml_value(source, depth + 1)
    else
      local is_empty = take(source, "<key%s*/>")
      if not is_empty and not take(source, "<key%s*>") then refuse() end
      local key = is_empty and "" or text_of_element(source, "key")
      skip_xml_space(source)
      set_entry(node, key, xml_value(source, depth + 1))
    end
    skip_xml_space(source)
  end
end

function xml_value(source, depth)
  count_value(source, depth)
  local first = source.next
  local name, ending = take(source, "<(%a+)%s*(/?)>")
  if name ~= "dict" and name ~= "array" then
    return xml_scalar(source, name or refuse(), first, ending == "/")
  end
  local node = name == "dict" and new_dictionary() or { kind = "array", elements = {} }
  if ending == "" then fill_container(source, node, depth) end
  node.at, node.length = first - 1, source.next - first
  return node
end

-- The part before the list.
local function take_prolog(source)
  take(source, "\239\187\191")
  local declaration = take(source, "(<%?xml%s[^?<>&]*%?>)")
  if declaration and declaration:find("encoding", 1, true) then
    local at = declaration:find("encoding", 1, true)
    local _, encoding = declaration:match("^encoding%s*=%s*([\"'])([%w-]+)%1", at)
    encoding = (encoding or refuse()):upper()
    if encoding ~= "UTF-8" and encoding ~= "US-ASCII" then refuse() end
  end
  skip_xml_space(source)
  local document_type = take(source, "<!DOCTYPE(%s[^%[<>']*)>")
  if document_type then
    local _, quotes = document_type:gsub('"', "")
    if quotes % 2 ~= 0 then refuse() end
  end
  skip_xml_space(source)
end

local function read_xml(source)
  if not is_utf8(source.bytes) or source.bytes:find("[%z\1-\8\11\12\14-\31]") then refuse() end
  source.next = 1
  take_prolog(source)
  if not take(source, "<plist%s*>") and not take(source, '<plist%s+version="[^"<>&]*"%s*>') then
    refuse()
  end
  skip_xml_space(source)
  local node = xml_value(source, 1)
  skip_xml_space(source)
  if not take(source, "</plist%s*>") then refuse() end
  skip_xml_space(source)
  if source.next <= #source.bytes then refuse() end
  return node
end
