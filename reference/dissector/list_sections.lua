-- The displayed parts of property lists.

local RADIO_ACCESS_TECHNOLOGY = "kHXCellMonitorCellRadioAccessTechnology"
local CELL_TYPE = "kHXCellMonitorCellType"

local readers = { binary = read_binary, XML = read_xml, text = read_text }

local function form_of(bytes)
  if bytes:find("^bplist") then return "binary" end
  if bytes:find("^\254\255") or bytes:find("^\255\254") then return "XML" end -- UTF-16
  local start = bytes:match("^\239\187\191()") or 1
  return bytes:find("^[ \t\r\n]*<[?!p]", start) and "XML" or "text"
end

-- The bytes, their form and the root node, which is nil if they cannot be read.
local function read_property_list(range)
  local bytes = range:raw()
  local list = { range = range, form = form_of(bytes) }
  local source = { range = range, bytes = bytes, values = 0 }
  local is_read, result = pcall(readers[list.form], source)
  if not is_read and result ~= REFUSAL then error(result, 0) end
  list.root = is_read and result or nil
  return list
end

local function add_list_label(tree, list)
  local label = string.format("Property list, %s, %d bytes", list.form, list.range:len())
  local item = tree:add(list.range, label)
  if not list.root then item:append_text(" (not read)") end
end

-- An untrusted text in one line.
local function printable(text)
  return (text:gsub("\194[\128-\159]", "\239\191\189"):gsub("%c", "\239\191\189"))
end

-- Values shown as sent

local function range_of_node(list, node)
  return list.range:range(node.at, node.length)
end

local add_entries -- defined below: values may be nested

local function add_elements(context, tree, elements, filters)
  for index, node in ipairs(elements) do
    local range = range_of_node(context.list, node)
    if node.text then
      tree:add(range, printable(node.text))
    else
      add_entries(context, tree:add(range, "Entry " .. (index - 1)), node, filters)
    end
  end
end

-- A value under a key; `filter` is the key's filter field if known, and `filters` the same for the
-- keys inside the value.
local function add_value(context, tree, key, node, filter, filters)
  local range = range_of_node(context.list, node)
  if node.text then
    add_labelled(context, tree, filter, range, node.text, nil, printable(key .. ": " .. node.text))
  else
    add_entries(context, tree:add(range, printable(key)), node, filters)
  end
end

function add_entries(context, tree, node, filters)
  if node.elements then return add_elements(context, tree, node.elements, filters) end
  for _, entry in ipairs(node.entries) do
    if entry.key then
      add_value(context, tree, entry.key, entry.value, filters and filters[entry.key], filters)
    end
  end
end

-- The cell monitor

local function is_cell(node, wanted)
  local technology, cell_type = find(node, RADIO_ACCESS_TECHNOLOGY), find(node, CELL_TYPE)
  if not technology or not cell_type then return false end
  local is_type = cell_type.kind == "string" and cell_type.text == wanted.cell_type
  for _, name in ipairs(wanted.technologies) do
    if is_type and technology.kind == "string" and technology.text == name then return true end
  end
  return false
end

local function cells_of(root, wanted)
  local cells = {}
  for _, node in ipairs(root.elements or {}) do
    if is_cell(node, wanted) then cells[#cells + 1] = node end
  end
  return cells
end

-- The last cell with a number for a field remains.
local function add_cell_fields(context, tree, fields, cells)
  for _, field in ipairs(fields) do
    local shown
    for _, cell in ipairs(cells) do
      local node = find(cell, field.list_key)
      shown = node and int32_of(node) and node or shown
    end
    if shown then
      local number = int32_of(shown)
      local text, value = text_of(field, field.low_bits and signed(number, field.low_bits) or number)
      add_item(context, tree, field, range_of_node(context.list, shown), text, value)
    end
  end
end

-- Sections

local list_sections = {}

list_sections["keys"] = function(context, root, part)
  local node = context.list.root
  local tree = root:add(range_of_node(context.list, node), part.head.section)
  for _, field in ipairs(part.fields) do
    local value = find(node, field.list_key)
    if value then add_value(context, tree, field.key, value, field.filter) end
  end
end

list_sections["elements"] = function(context, root, part)
  local node = context.list.root
  local tree = root:add(range_of_node(context.list, node), part.head.section)
  if node.elements then
    add_elements(context, tree, node.elements)
  else
    tree:append_text(" (no array)")
  end
end

list_sections["each cell"] = function(context, root, part)
  local cells = cells_of(context.list.root, part.list)
  local last = cells[#cells] or context.list.root
  local tree = root:add(range_of_node(context.list, last), part.head.section)
  if #cells == 0 then tree:append_text(" (no such cell)") end
  add_cell_fields(context, tree, part.fields, cells)
end

list_sections["first cell"] = function(context, root, part)
  local first = cells_of(context.list.root, part.list)[1]
  local tree = root:add(range_of_node(context.list, first or context.list.root), part.head.section)
  if not first then return tree:append_text(" (no such cell)") end
  add_cell_fields(context, tree, part.fields, { first })
end

list_sections["cell entries"] = function(context, root, part)
  local tree = root:add(range_of_node(context.list, context.list.root), part.head.section)
  for index, cell in ipairs(cells_of(context.list.root, part.list)) do
    local entry = tree:add(range_of_node(context.list, cell), "Entry " .. (index - 1))
    add_cell_fields(context, entry, part.fields, { cell })
  end
end

-- The sections of a log record whose body is a property list.
local function add_list_sections(context, tree, parts)
  local has_body = context.record:len() > HEADER_LENGTH
  context.list = has_body and read_property_list(context.record:range(HEADER_LENGTH))
    or { range = context.record:range() }
  for _, part in ipairs(parts) do
    if context.list.root then
      list_sections[part.list.part](context, tree, part)
    else
      tree:add(context.list.range, part.head.section):append_text(" (not read)")
    end
  end
  if has_body then add_list_label(tree, context.list) end
end

-- Object streams

local folded -- defined below: objects are nested

-- Replaces a dictionary with one entry by its value, and omits the first element of an array. Nothing
-- if a value has a type that objects cannot contain.
local function display_form(node)
  if node.kind == "string" then return node end
  local form = { kind = node.kind, at = node.at, length = node.length }
  if node.kind == "dictionary" then
    form.entries = {}
    for index, entry in ipairs(node.entries) do
      local value = folded(entry.value)
      if not value then return nil end
      form.entries[index] = { key = entry.key, value = value }
    end
    return form
  end
  if node.kind ~= "array" then return nil end
  form.elements = {}
  for index, element in ipairs(node.elements) do
    local value = folded(element)
    if not value then return nil end
    form.elements[index - 1] = value
  end
  form.elements[0] = nil
  return form
end

function folded(node)
  local form = display_form(node)
  local is_single = form and form.entries and #form.entries == 1
  return is_single and form.entries[1].value or form
end

local function add_object_sections(context, tree, form)
  for _, entry in ipairs(form.entries) do
    local known = context.technology.objects[entry.key] or {}
    if entry.key then
      add_value(context, tree, entry.key, entry.value, known.filter, known.keys)
    end
  end
end

local function dissect_object(technology, buffer, pinfo, tree)
  local context = { technology = technology, pinfo = pinfo }
  context.list = read_property_list(buffer:range())
  local form = context.list.root and display_form(context.list.root)
  if form and form.entries then
    add_object_sections(context, tree, form)
  elseif form and form.elements then
    add_elements(context, tree, form.elements)
  elseif form then
    tree:add(range_of_node(context.list, form), printable(form.text))
  elseif context.list.root then
    tree:append_text(" (an object of an unknown type)")
  end
  add_list_label(tree, context.list)
end
