// Loaded with node --require: makes the npm packages of the browser tests
// look uninstalled, as on a machine where scripts/setup.sh --tests did not
// run.
'use strict';

const Module = require('module');
const resolve = Module._resolveFilename;
Module._resolveFilename = function (request, ...rest) {
  if (request === 'playwright-core') {
    const error = new Error(`Cannot find module '${request}'`);
    error.code = 'MODULE_NOT_FOUND';
    throw error;
  }
  return resolve.call(this, request, ...rest);
};
