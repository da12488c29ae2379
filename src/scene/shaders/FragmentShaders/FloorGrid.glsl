// The floor with its lines: large ones, and smaller ones of half their brightness.
const vec3 c_Colour = vec3(0.2);
const float c_AlphaFromBelow = 0.25;
const float c_AlphaFromAbove = 0.75;

// Tiled, it is a grid of lines.
uniform sampler2D t_Texture;
// Of the large lines, and of the small ones.
uniform vec2 u_GridSpacings;

varying vec2 v_Floor;
varying float v_CameraHeight;

void main()
{
	float lines = texture2D(t_Texture, v_Floor / u_GridSpacings.x).r
		+ 0.5 * texture2D(t_Texture, v_Floor / u_GridSpacings.y).r;
	gl_FragColor = vec4(c_Colour + lines, v_CameraHeight < 0.0 ? c_AlphaFromBelow : c_AlphaFromAbove);
}
