-- Records

-- The start of the subpacket; nothing if it is missing.
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

-- The log record without its transport prefix; nothing if it is empty.
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
  tree:add(header.length, record:range(), record:len()):set_generated()
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
  local context = { technology = technology, record = record, pinfo = pinfo, start = 0 }
  local of_lists = {}
  for _, part in ipairs(known or {}) do
    if part.list then
      of_lists[#of_lists + 1] = part
    else
      add_section(context, tree, part)
    end
  end
  if #of_lists > 0 then add_list_sections(context, tree, of_lists) end
end

-- Registration

local function each_field(part, see)
  for _, field in ipairs(part.fields or {}) do see(field) end
  for _, list in ipairs(part.lists or {}) do each_field(list, see) end
  for _, subpacket in ipairs(part.subpackets or {}) do each_field(subpacket, see) end
end

-- The keys of an object stream as fields whose values are texts.
local function each_object_key(technology, see)
  for section, known in pairs(technology.objects or {}) do
    see({ key = section, filter = known.filter })
    for key, filter in pairs(known.keys) do see({ key = key, filter = filter }) end
  end
end

-- A filter field for each key: a number if every value of the key is one.
local function make_fields(technology)
  technology.fields = {}
  local names = {}
  local function see(field)
    local known = technology.fields[field.filter] or { is_number = true, name = field.key }
    known.is_number = known.is_number and field.format ~= nil
    if not technology.fields[field.filter] then names[#names + 1] = field.filter end
    technology.fields[field.filter] = known
  end
  for _, code in pairs(technology.codes) do
    for _, part in ipairs(code) do each_field(part, see) end
  end
  each_object_key(technology, see)
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
    length = ProtoField.uint32(technology.name .. ".length", "Record length"),
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
      dissect_object(technology, buffer, pinfo, tree)
    else
      dissect_record(technology, buffer, pinfo, tree)
    end
  end

  DissectorTable.get("wtap_encap"):add(wtap[technology.encapsulation], proto)
end

for _, technology in ipairs(technologies) do register(technology) end
