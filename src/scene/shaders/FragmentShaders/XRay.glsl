// A body whose edges show, added to what is behind it.
// With its factor in alpha.
uniform vec4 u_DiffuseColour;
uniform sampler2D t_DiffuseTexture;
uniform bool u_DiffuseTextureEnabled;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_Eye;
varying vec2 v_UV;

void main()
{
	vec3 texel = u_DiffuseTextureEnabled ? texture2D(t_DiffuseTexture, v_UV).rgb
		: u_DiffuseColour.rgb * u_DiffuseColour.a;
	float edge = 1.0 - dot(-normalize(v_Eye), normalize(v_Normal));
	gl_FragColor = vec4(v_Colour.rgb, edge * 0.25 + dot(texel, texel) * 0.03);
}
