-- cvmxl_utilities: language names and the module form of the term tables.
--
-- Language indices: 0 English, 1 French, 2 German, 3 Japanese, 4 Korean,
-- 5 Simplified Chinese; anything else is "zzz", which reads English.

local M = {}

local codes = { [0] = "eng", "fra", "deu", "jpn", "kor", "chs" }
local longNames = { [0] = "English", "French", "German", "Japanese", "Korean", "ChineseS" }

-- The three-letter name of a language index ("zzz" for any other value).
function M.languageCode(lang)
  return codes[tonumber(lang) or -1] or "zzz"
end

-- The long name used for folders; English for "zzz".
function M.longLanguageName(lang)
  return longNames[tonumber(lang) or -1] or "English"
end

-- A status code as a signed 32-bit number (0xBFFA... literals are positive
-- in a script).
function M.signedCode(code)
  if type(code) == "number" and code >= 2147483648 then return code - 4294967296 end
  return code
end

-- The module of a string table (static descriptions or common terms).
-- `entries` maps a key (a status code or a term key) to its text. Numeric
-- keys are normalised to signed 32-bit codes, so a table may write either
-- 0xBFFA1190 or -1074130544.
function M.stringTable(entries)
  local normalised = {}
  for key, text in pairs(entries) do
    normalised[M.signedCode(key)] = text
  end
  return {
    encoding = "utf-8",
    entries = normalised,
    getString = function(key)
      return normalised[M.signedCode(key)]
    end,
  }
end

-- The key of an attribute id: 8 upper-case hex digits.
function M.attributeKey(id)
  return string.format("%08X", math.floor(id) % 4294967296)
end

-- The module of an attribute table. `attributes` maps an attribute id (a
-- number, or already its 8-digit key) to { name = short name, values = {
-- [n] = enum value name } } (values only for enumerated attributes).
-- getAttribute looks an id up by its 8-digit key; ids the table lacks are
-- looked up in the module named `fallback`, when given.
function M.attributeTable(attributes, fallback)
  local normalised = {}
  for id, entry in pairs(attributes) do
    local key = type(id) == "number" and M.attributeKey(id) or string.upper(id)
    normalised[key] = entry
  end
  return {
    encoding = "utf-8",
    entries = normalised,
    getAttribute = function(key)
      local entry = normalised[key]
      if entry == nil and fallback then
        local ok, other = pcall(require, fallback)
        if ok and type(other) == "table" and other.getAttribute then entry = other.getAttribute(key) end
      end
      return entry
    end,
  }
end

return M
