// MathJax puts a frame of its own in the place of each block.
MathJax.Hub.Queue(() => {
  const frames = [...document.querySelectorAll('.MathJax')];
  const shown = frames.filter(frame => frame.getBoundingClientRect().width > 0).length;
  const report = document.createElement('pre');
  report.id = 'report';
  report.textContent = 'frames ' + shown + ' errors ' +
    document.querySelectorAll('.MathJax_Error, .merror').length + '\nend of report';
  document.body.append(report);
});
