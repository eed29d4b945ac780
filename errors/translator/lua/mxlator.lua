-- mxlator: the translator of this system's status codes and structured error
-- descriptions.
--
--   getStaticDesc(code, lang, ade)          the static description of a code
--   getDynamicDesc(errjson, lang, ade, fmt) the localized items of a
--                                           description, as JSON text
--   listStaticDescs(lang)                   every code of the static table
--
-- Static descriptions come from the term table "errors_<lang>", then
-- "errors_eng", then the explanation files of the QM errors folder and of the
-- shared errors folder, else "Error description not found". Infrastructure
-- codes are looked up by their original (unmapped) value.

local utils = require "cvxlatorluautils"
local mu = require "cvmxl_utilities"
local json = require "json"
local cjson = require "cjson"
local stdint = require "stdint"

local M = {}

local settings = {}

-- Host development environments by index; only "none" is known to this
-- system, so environment-specific attribute tables are never chosen.
local environments = { [0] = "none" }

local notFound = "Error description not found"

-- Usage keys whose values are attribute ids, shown by the attribute's name.
local attributeUsages = {
  kUsageTypeAttributeId = true,
  kUsageTypeAttributeIdentifier = true,
  kUsageTypeAffectedAttribute = true,
  kUsageTypeConflictingAttr = true,
  kUsageTypeConflictingProperty = true,
  kUsageTypeUnspecifiedProperty = true,
}

-- Members of a description that the dynamic step consumes; anything else is
-- shown as "rest_of_input_json" in the debug items.
local consumed = {
  translator = true, translator_info = true, component = true, file = true, line = true,
  nested_error = true, internal_error = true, code = true,
}

function M.init(s)
  settings.driverName = s.driverName
  if s.QMErrorsDir then settings.QMErrorsDir = utils.expandPath(s.QMErrorsDir) end
  if s.cvSharedErrorsDir then settings.cvSharedErrorsDir = utils.expandPath(s.cvSharedErrorsDir) end
end

local function lookupTables(code, lc)
  local t = utils.loadTable("errors_" .. lc)
  local text = t and t.getString(code)
  if text == nil and lc ~= "eng" then
    t = utils.loadTable("errors_eng")
    text = t and t.getString(code)
  end
  return text
end

-- Returns the text, and the first failure met on the way when no source
-- had the code (a broken explanation file, an unreadable folder).
function M.getStaticDesc(code, lang, ade)
  code = utils.unmapErrorCode(mu.signedCode(code))
  local text = lookupTables(code, mu.languageCode(lang))
  if text then return text end
  local failure
  if settings.driverName and settings.QMErrorsDir then
    local found, err = utils.searchQMErrors(settings.QMErrorsDir, settings.driverName, lang, code)
    if found then return found end
    failure = err
  end
  if settings.cvSharedErrorsDir then
    local found, err = utils.searchSharedErrors(settings.cvSharedErrorsDir, lang, code)
    if found then return found end
    failure = failure or err
  end
  return notFound, failure
end

function M.listStaticDescs(lang)
  local lc = mu.languageCode(lang)
  local own = utils.loadTable("errors_" .. lc)
  local english = utils.loadTable("errors_eng")
  local codes, list = {}, {}
  for code in pairs(english and english.entries or {}) do codes[#codes + 1] = code end
  table.sort(codes)
  for _, code in ipairs(codes) do
    local text = (own and own.getString(code)) or english.getString(code)
    list[#list + 1] = { code, text }
  end
  return list
end

-- The attribute table, in the order: language and environment (when the
-- environment is not "none"), English and environment, language, English,
-- then the default table.
local function chooseAttributeTable(lc, env, notes)
  local driver = settings.driverName or ""
  local names = {}
  if env ~= "none" then
    names[#names + 1] = driver .. "_attributes_" .. lc .. "_" .. env
    names[#names + 1] = driver .. "_attributes_eng_" .. env
  end
  names[#names + 1] = driver .. "_attributes_" .. lc
  names[#names + 1] = driver .. "_attributes_eng"
  names[#names + 1] = "cvmxl_defaultAttrTable"
  for _, name in ipairs(names) do
    local t = utils.loadTable(name)
    if t then return t end
  end
  notes[#notes + 1] = "Cannot load " .. names[#names]
  return nil
end

-- Descriptions are read by the fast reader, unless they hold an integer
-- literal too long for a double to keep exact: then by the script reader,
-- which keeps 64-bit integers exact. Both refuse nesting beyond 200 levels.
cjson.decode_max_depth(200)
local function decode(text)
  if string.find(text, "%d%d%d%d%d%d%d%d%d%d%d%d%d%d%d%d") then return json.decode(text) end
  return cjson.decode(text)
end

local function isNull(v)
  return v == nil or v == json.null or v == cjson.null
end

local function numberText(v)
  if stdint.isinteger(v) then return tostring(v) end
  if v == math.floor(v) and math.abs(v) < 2 ^ 63 then return string.format("%d", v) end
  return string.format("%.15g", v)
end

local function scalarText(v)
  local kind = type(v)
  if kind == "string" then return v end
  if kind == "number" or stdint.isinteger(v) then return numberText(v) end
  if kind == "boolean" then return tostring(v) end
  if isNull(v) then return "" end
  return json.encode(v)
end

local function attributeKey(id)
  if stdint.isinteger(id) then return stdint.tohex(stdint.uint64(id) % stdint.uint64(4294967296), 8) end
  if type(id) ~= "number" then return nil end
  id = math.floor(id) % 4294967296
  return string.format("%08X", id)
end

local function attributeName(attrs, id)
  local key = attributeKey(id)
  if not key then return scalarText(id) end
  local entry = attrs and attrs.getAttribute(key)
  if entry and entry.name then return entry.name end
  return "0x" .. key
end

local function enumName(attrs, attributeId, value)
  local key = attributeKey(attributeId)
  local entry = key and attrs and attrs.getAttribute(key)
  local names = entry and entry.values
  local number = tonumber(value) or (stdint.isinteger(value) and stdint.tonumber(value))
  local name = names and number and names[number]
  if name then return name end
  return scalarText(value)
end

-- Applies `show` to a scalar or to each element of an array.
local function mapValue(value, show)
  if type(value) == "table" and not isNull(value) and not stdint.isinteger(value) then
    local out = {}
    for i = 1, #value do out[i] = show(value[i]) end
    if #out == 0 then return "" end
    return out
  end
  return show(value)
end

local function term(terms, key)
  local text = terms and terms.getString(key)
  return text or key
end

local function usageItem(item, terms, attrs)
  local key = tostring(item.usage or "")
  local valueType = item.value_type
  local value
  if attributeUsages[key] then
    value = mapValue(item.value, function(v) return attributeName(attrs, v) end)
  elseif type(valueType) == "table" and valueType.type == "enum" then
    value = mapValue(item.value, function(v) return enumName(attrs, valueType.id, v) end)
  else
    value = mapValue(item.value, scalarText)
  end
  return { type = "usage", key = term(terms, key), value = value }
end

function M.getDynamicDesc(errjson, lang, ade, format)
  if format ~= "json1" then
    return nil, -52029, "unsupported description format: " .. tostring(format)
  end
  local doc = decode(errjson)
  if type(doc) ~= "table" then error("description is not a JSON object", 0) end
  local lc = mu.languageCode(lang)
  local env = environments[tonumber(ade) or 0] or "none"
  local notes = {}
  local attrs = chooseAttributeTable(lc, env, notes)
  local terms = utils.loadTable("commonTerms_" .. lc) or utils.loadTable("commonTerms_eng")

  local dynamic, debug = {}, {}
  local info = doc.translator_info
  local data = type(info) == "table" and info.ordered_data
  if type(data) == "table" then
    for _, item in ipairs(data) do
      if type(item) == "table" then
        local kind = item.type
        if kind == "usage" then
          dynamic[#dynamic + 1] = usageItem(item, terms, attrs)
        elseif kind == "elaboration" or kind == "header" then
          dynamic[#dynamic + 1] = { type = kind, value = term(terms, tostring(item.usage or "")) }
        elseif kind == "empty" then
          dynamic[#dynamic + 1] = { type = "empty" }
        end
      end
    end
  end

  local function addDebug(key, value)
    if not isNull(value) then
      debug[#debug + 1] = { type = "usage", key = term(terms, key), value = scalarText(value) }
    end
  end
  addDebug("Component", doc.component)
  addDebug("File", doc.file)
  addDebug("Line", doc.line)
  if type(doc.internal_error) == "table" then
    for _, record in ipairs(doc.internal_error) do
      if type(record) == "table" then
        notes[#notes + 1] = scalarText(record.api) .. " " .. scalarText(record.code) .. ": " ..
          scalarText(record.string)
      end
    end
  end
  if #notes > 0 then addDebug("Internal Error", table.concat(notes, "; ")) end
  local rest, any = {}, false
  for key, value in pairs(doc) do
    if not consumed[key] then
      rest[key] = value
      any = true
    end
  end
  if any then addDebug("rest_of_input_json", json.encode(rest)) end

  local out = { dynamic = dynamic, debug = debug }
  return cjson.encode(out)
end

return M
