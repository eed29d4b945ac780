-- cvxlatorlua: the glue between the host and one translator script. It holds
-- the translator's name and settings and forwards the host's calls.

local cjson = require "cjson"

local M = {}

local xlator
local xlatorName
local settings

-- Called once by the environment setup with the translator name and its
-- settings (JSON text of the "cvxlatorlua_settings" object).
function M.setup(name, settingsJson)
  xlatorName = name
  settings = cjson.decode(settingsJson)
  if type(settings) ~= "table" then settings = {} end
  xlator = require(name)
  if type(xlator) ~= "table" then error("translator " .. name .. " is not a module", 0) end
  if xlator.init then xlator.init(settings) end
end

function M.name()
  return xlatorName
end

function M.getStaticDesc(code, lang, ade)
  if not xlator.getStaticDesc then error("xlator doesn't support getStaticDesc", 0) end
  return xlator.getStaticDesc(code, lang, ade)
end

function M.getDynamicDesc(errjson, lang, ade, format)
  if not xlator.getDynamicDesc then error("xlator doesn't support getDynamicDesc", 0) end
  return xlator.getDynamicDesc(errjson, lang, ade, format)
end

function M.listStaticDescs(lang)
  if not xlator.listStaticDescs then return {} end
  return xlator.listStaticDescs(lang)
end

return M
